#pragma once

// The program's one version record; the caption and the about box read it.
namespace telvio {
inline constexpr int kVersionMajor = 1;
inline constexpr int kVersionMinor = 36;
} // namespace telvio
