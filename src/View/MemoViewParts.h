// Pieces that several pages build alike: the page's layout, the empty state, the new-memo button.
#ifndef SRC_VIEW_MEMOVIEWPARTS_H
#define SRC_VIEW_MEMOVIEWPARTS_H

#include <Elementary.h>

// Puts in *layout a layout of the theme's group that expands to fill the page; false when the theme has no
// such group (the layout is made all the same, and the caller says whether that is worth a log line).
bool memoViewPageLayoutAdd(Evas_Object *parent, const char *group, Evas_Object **layout);

// The "nothing here" layout, centred, with the text `textId` of `domain` and the help on creating memos.
Evas_Object *memoViewNoContentLayoutAdd(Evas_Object *parent, const char *domain, const char *textId);

// The floating button on both sides of the base layout, holding the round new-memo button that calls `cb`
// with `data` when clicked; null when the floating button could not be made. The caller puts it in its part.
Evas_Object *memoViewNewMemoFloatingButtonAdd(Evas_Object *baseLayout, Evas_Smart_Cb cb, void *data);

#endif
