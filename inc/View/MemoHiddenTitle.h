#ifndef INC_VIEW_MEMOHIDDENTITLE_H
#define INC_VIEW_MEMOHIDDENTITLE_H

#include <Elementary.h>

// The title bar of the hidden memos' pages: the text (a key of the "memo-sub" domain) over the page, and, with
// a callback, a back button on its left that goes the page's back way.
void memoHiddenTitleSet(Elm_Object_Item *naviItem, const char *textId, Evas_Smart_Cb backCb, void *data);

#endif
