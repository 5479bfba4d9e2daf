#include "controls/gdate_layout.h"

#include <cmath>

#include "controls/twips.h"

namespace zv {

QRect NowButtonTwips(int innerHeightTwips) {
    const int height = innerHeightTwips > 60 ? innerHeightTwips - 30 : 60;
    return QRect(30, 15, 285, height);
}

int CaptionWidthPixels(int16_t ratio, int innerWidthTwips) {
    // nearbyint rounds halves to even under the default rounding mode.
    return static_cast<int>(std::nearbyint(ratio / 100.0 * innerWidthTwips / kTwipsPerPixel));
}

}  // namespace zv
