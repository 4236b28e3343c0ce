#ifndef SRC_BOX_MEMOBOXITEMPRIVATE_H
#define SRC_BOX_MEMOBOXITEMPRIVATE_H

// Shared between the MemoBoxItem*.cpp and MemoEntryFilter*.cpp files only.

#include <string>

#include <WUiTimer.h>

#include "Box/MemoBoxItem.h"

// Text domain of the editor's translatable texts.
#define MEMO_SUB_DOMAIN "memo-sub"

// Characters that all body items of a memo share; the title has its own 128.
const int MEMO_BOX_BODY_CHAR_LIMIT = 4096;
const int MEMO_BOX_TITLE_CHAR_LIMIT = 128;

// A tap that moved further than this in x or y is a drag.
const int MEMO_BOX_TAP_MOVE_LIMIT = 20;

#define MEMO_BOX_TEXT_STYLE_NORMAL "DEFAULT='color=#000000ff'"
#define MEMO_BOX_TEXT_STYLE_CHECKED "DEFAULT='strikethrough=on strikethrough_color=#00000050 color=#00000064'"

#define MEMO_BOX_TEXT_STYLE_TITLE "DEFAULT='font_weight=Bold color=#221e14ff'"

#define MEMO_BOX_LINE_BREAK "<br/>"

// A picture of a paste that must be shrunk before the insertion: read from `source`, written to `target`
// in the memo's folder at width x height (`ratio` is the scale that gives them).
struct MemoBoxItem::__ResizeRequest {
	std::string source;
	std::string target;
	int width;
	int height;
	float ratio;
};

// One picture to shrink on a worker. The worker reads only its own copy of the parameters; `item` is
// cleared by the item's destructor so that an end callback after it finds nobody to tell.
struct MemoBoxItem::__ResizeJob {
	MemoBoxItem *item;
	// The picture read, and the file written (the same file when a copy is shrunk in place).
	std::string source;
	std::string path;
	int width;
	int height;
	float ratio;
	bool insertsPendingText;
	Ecore_Thread *thread;
};

// Replaces every occurrence of `from` in `text` by `to`.
void memoBoxReplaceAll(std::string &text, const std::string &from, const std::string &to);

// True when `text` starts / ends with `piece`.
bool memoBoxStartsWith(const std::string &text, const std::string &piece);
bool memoBoxEndsWith(const std::string &text, const std::string &piece);

#endif
