#pragma once
// The layout rules of the date box, in twips as its owners think of them.

#include <QRect>
#include <cstdint>

namespace zv {

// Where the today button goes inside a box of the given inner height.
QRect NowButtonTwips(int innerHeightTwips);

// Width of the built-in caption in pixels: ratio percent of the inner width, rounded to the
// nearest pixel with halves to even.
int CaptionWidthPixels(int16_t ratio, int innerWidthTwips);

}  // namespace zv
