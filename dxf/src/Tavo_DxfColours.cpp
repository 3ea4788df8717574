// The ACI table and nearest-colour search.
#include "Tavo_DxfColours.h"

#include <cstdlib>

namespace {

// ACI 10 ... 249 run round the colour wheel: 24 hues 15 degrees apart, each
// with ten shades: five brightnesses, each fully and half saturated.
constexpr int kFirstWheelIndex = 10;
constexpr int kLastWheelIndex = 249;
constexpr int kShadesPerHue = 10;
constexpr int kWheelBrightness[5] = {255, 204, 153, 127, 76};

// ACI 1 ... 9 and the greys 250 ... 255.
constexpr uint32_t kFixedColours[10] = {
    0x000000,
    0xFF0000,
    0xFFFF00,
    0x00FF00,
    0x00FFFF,
    0x0000FF,
    0xFF00FF,
    0xFFFFFF,
    0x808080,
    0xC0C0C0,
};
constexpr uint32_t kGreys[6] = {0x333333, 0x505050, 0x696969, 0x828282, 0xBEBEBE, 0xFFFFFF};

Tavo_DxfRgb WheelColour(int aci)
{
    const int hueStep = (aci - kFirstWheelIndex) / kShadesPerHue; // 0 ... 23
    const int shade = (aci - kFirstWheelIndex) % kShadesPerHue;
    const int high = kWheelBrightness[shade / 2];
    const int low = (shade % 2) ? high / 2 : 0;
    // Position within the 60-degree sextant, in quarters: hues are 15 degrees
    // apart, so each sextant holds four of them.
    const int sextant = hueStep / 4;
    const int quarter = hueStep % 4;
    const int rising = low + (high - low) * quarter / 4;
    const int falling = low + (high - low) * (4 - quarter) / 4;
    int r = 0, g = 0, b = 0;
    switch (sextant) {
    case 0:
        r = high;
        g = rising;
        b = low;
        break;
    case 1:
        r = falling;
        g = high;
        b = low;
        break;
    case 2:
        r = low;
        g = high;
        b = rising;
        break;
    case 3:
        r = low;
        g = falling;
        b = high;
        break;
    case 4:
        r = rising;
        g = low;
        b = high;
        break;
    default:
        r = high;
        g = low;
        b = falling;
        break;
    }
    return {uint8_t(r), uint8_t(g), uint8_t(b)};
}

} // namespace

Tavo_DxfRgb Tavo_DxfAciColour(int aci)
{
    aci = std::abs(aci);
    if (aci >= 1 && aci <= 9)
        return Tavo_DxfRgb::FromPacked(kFixedColours[aci]);
    if (aci >= kFirstWheelIndex && aci <= kLastWheelIndex)
        return WheelColour(aci);
    if (aci > kLastWheelIndex && aci <= 255)
        return Tavo_DxfRgb::FromPacked(kGreys[aci - kLastWheelIndex - 1]);
    return {};
}

int Tavo_DxfColourDistance(const Tavo_DxfRgb& a, const Tavo_DxfRgb& b)
{
    const int dr = int(a.red) - b.red;
    const int dg = int(a.green) - b.green;
    const int db = int(a.blue) - b.blue;
    return 2 * dr * dr + 4 * dg * dg + 3 * db * db;
}

int Tavo_DxfNearestColour(const Tavo_DxfRgb& colour, const Tavo_DxfRgb* candidates, int count)
{
    int best = -1;
    int bestDistance = 0;
    for (int i = 0; i < count; ++i) {
        const int distance = Tavo_DxfColourDistance(colour, candidates[i]);
        if (best < 0 || distance < bestDistance) {
            best = i;
            bestDistance = distance;
        }
    }
    return best;
}
