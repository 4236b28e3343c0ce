#ifndef INC_BOX_MEMOBOXIMAGEMARKUP_H
#define INC_BOX_MEMOBOXIMAGEMARKUP_H

#include <string>
#include <vector>

// Finding and taking out image tags in a box item's markup, without widgets.

// The longest path taken from a tag, terminator included; longer ones are cut.
const size_t MEMO_BOX_IMAGE_PATH_BUFFER = 1024;

// The paths of the image tags in `markup`, in order: for each "href=file://" that has a "</item>"
// behind it, the text up to the first blank or ">", cut to 1023 bytes. Null gives none.
std::vector<std::string> memoBoxImagePaths(const char *markup);

// Erases the tag that holds `path`: from the nearest "<item" before the first occurrence of the path
// through the "></item>" behind it. The break behind the tag stays. False, unchanged, when the path,
// the opening or the closing is not found.
bool memoBoxImageEraseByPath(std::string &markup, const char *path);

// The same with the marks "<item size" and "</item>", the form used when a picture is deleted from
// outside the editor (the path may be just the file's UUID).
bool memoBoxImageEraseTag(std::string &markup, const char *path);

#endif
