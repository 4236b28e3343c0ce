#ifndef INC_BOX_MEMOBOXIMAGESIZE_H
#define INC_BOX_MEMOBOXIMAGESIZE_H

#include <string>

#include <Evas.h>

// How an image stands in a box item's entry: an item tag whose width fits the screen at the current
// scale and whose height follows the picture's proportions. Widget free except for the picture
// probe, which needs a canvas.

// The tag templates, with width, height and absolute path filled in. The second one is used when the
// cursor is not at the left edge, so that the image starts a line of its own.
#define MEMO_BOX_IMAGE_TAG_FORMAT "<item size=%dx%d vsize=full href=file://%s></item><br/>"
#define MEMO_BOX_IMAGE_TAG_BREAK_FORMAT "<br/><item size=%dx%d vsize=full href=file://%s></item><br/>"

// Room added below the picture inside its tag.
const int MEMO_BOX_IMAGE_EXTRA_HEIGHT = 40;

// Most images one memo holds.
const int MEMO_BOX_IMAGE_MAX_COUNT = 10;

// The display width and the default height of an image for an Elementary scale. The two scales of
// the product displays (1.8 and 3.8) are compared exactly; every other scale takes the middle size.
// Check items are narrower than text items because of their check box.
void memoBoxImageTextSize(double scale, int *width, int *defaultHeight);
void memoBoxImageCheckSize(double scale, int *width, int *defaultHeight);

// The tag height of a picture shown `width` wide: pictureHeight * width / pictureWidth + 40, in
// integers. `defaultHeight` when the picture's size is unknown (a side of 0 or less).
int memoBoxImageTagHeight(int pictureWidth, int pictureHeight, int width, int defaultHeight);

// One tag from the templates above; `path` null counts as "". The result is cut to 2047 bytes, the
// editor's tag buffer.
std::string memoBoxImageTag(int width, int height, const char *path, bool leadingBreak);

// Reads the size of the picture at `path` through a temporary image object on `evas`, without decoding
// its pixels. False when the file cannot be loaded (the outs stay untouched); `loadError` (may be
// null) gets the Evas load error either way.
bool memoBoxImageProbe(Evas *evas, const char *path, int *width, int *height, int *loadError);

#endif
