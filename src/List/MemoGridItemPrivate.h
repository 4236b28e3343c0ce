#ifndef SRC_LIST_MEMOGRIDITEMPRIVATE_H
#define SRC_LIST_MEMOGRIDITEMPRIVATE_H

// Helpers shared by the files of MemoGridItem.

#include <initializer_list>

#include <Elementary.h>

#include "List/MemoGridText.h"

// A size of the layouts in base-scale units, in pixels of the current scale.
int memoGridScaled(int size);
// The colour of a colour class as the gengrid sees it; opaque black when it is unknown.
MemoGridColor memoGridColorOf(Evas_Object *grid, const char *code);
// Paints obj (an image) in a colour; Evas wants it premultiplied.
void memoGridPaint(Evas_Object *obj, const MemoGridColor &color);
// True for one of the layout codes that follow.
bool memoGridCodeIn(int code, std::initializer_list<int> codes);

#endif
