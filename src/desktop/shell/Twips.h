#pragma once

// Positions and sizes of the window are given in twips (1/1440 inch). At 96 dpi that is 15 twips
// per pixel; Qt scales logical pixels for high-dpi screens itself.
inline constexpr int kTwipsPerPixel = 15;
inline constexpr int twipsToPixels(int twips) {
    return (twips + (twips >= 0 ? 7 : -7)) / kTwipsPerPixel;
}
inline constexpr int pixelsToTwips(int pixels) {
    return pixels * kTwipsPerPixel;
}
