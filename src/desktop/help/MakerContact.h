#pragma once

// The maker's contact details, shown in the maker's about box. The one place to change them.
namespace MakerContact {

inline constexpr const char* kCompany = "KVO Instruments Pty Ltd";
inline constexpr const char* kStreet = "14 Calibration Way";
inline constexpr const char* kSuburbCity = "Ferntree Gully,  Melbourne";
inline constexpr const char* kCountryPostcode = "Australia   3156";
inline constexpr const char* kPhoneNational = "Phone  (03) 5550 1436";
inline constexpr const char* kPhoneInternational = "Phone  +61 3 5550 1436";
inline constexpr const char* kFaxNational = "Fax  (03) 5550 1437";
inline constexpr const char* kFaxInternational = "Fax  +61 3 5550 1437";

inline constexpr const char* kEmail = "sales@kvo-instruments.example";
inline constexpr const char* kWebShown = "www.kvo-instruments.example";
inline constexpr const char* kWebUrl = "https://www.kvo-instruments.example/";

// The notice of the program's about box.
inline constexpr const char* kNotice =
    "Copyright (c) 2026  KVO Instruments Pty Ltd.  All rights reserved.";

} // namespace MakerContact
