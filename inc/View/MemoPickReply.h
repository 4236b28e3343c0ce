#ifndef INC_VIEW_MEMOPICKREPLY_H
#define INC_VIEW_MEMOPICKREPLY_H

#include <app_control.h>

class MemoDocInfo;

// Answers the pick request with the memo: its text (title and line end, then the display content with
// "[ ]", "[V]" and line ends for its check lines) under /appcontrol/data/text, and under
// /appcontrol/data/path the paths of copies of its files in the shared area that other applications may
// read ("shared/data/media/<memo>/abcdXY/memo_media_XY.png" for "data/media/<memo>/abcdXY.png"), made on the
// first pick and reused after. A null record logs "doc info is null" and sends nothing. The list and the
// search view answer alike.
void memoSendPickReply(MemoDocInfo *docInfo, app_control_h request);

#endif
