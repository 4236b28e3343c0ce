#ifndef SRC_BOX_MEMOENTRYFILTERTAGS_H
#define SRC_BOX_MEMOENTRYFILTERTAGS_H

// Scanning image tags ("<item ...></item>") inside entry markup, for the entry filter.

#include <functional>
#include <string>

#define MEMO_ITEM_CLOSE "></item>"
#define MEMO_ITEM_HREF_FILE "href=file://"

// Steps 2 to 7 of the body entry filter on `text`: the markup to insert, before its pictures are taken
// into the memo. `imageCount` is asked, only when the text holds an image tag, how many pictures the memo
// has (-1: none); pictures over the limit go with a toast.
std::string memoEntryFilterMarkup(const char *text, const std::function<int()> &imageCount);

// The position just behind the tag that starts at tagStart: behind its "</item>", else behind its ">",
// else the end of the text.
size_t memoFilterTagEnd(const std::string &text, size_t tagStart);

// The file path of a tag's "href=file://" (up to a blank or ">"); empty when it has none.
std::string memoFilterTagPath(const std::string &tag);

// Replaces the path of a tag's "href=file://" by `path`.
void memoFilterTagSetPath(std::string &tag, const std::string &path);

// Reads "size=WxH" of a tag; false when it has none.
bool memoFilterTagSize(const std::string &tag, int *width, int *height);

// Writes "size=WxH" of a tag with the new numbers.
void memoFilterTagSetSize(std::string &tag, int width, int height);

#endif
