// Image tags inside a box item's markup: listing their paths and erasing one.
#include "Box/MemoBoxImageMarkup.h"

#include <cstring>

namespace
{
const char *const HREF_FILE = "href=file://";
const char *const ITEM_END = "</item>";

bool eraseBetween(std::string &markup, const char *path, const char *openMark, const char *closeMark)
{
	if (!path || !*path)
		return false;
	const size_t at = markup.find(path);
	if (at == std::string::npos)
		return false;
	const size_t open = markup.rfind(openMark, at);
	const size_t close = markup.find(closeMark, at);
	if (open == std::string::npos || close == std::string::npos)
		return false;
	markup.erase(open, close + strlen(closeMark) - open);
	return true;
}
} // namespace

std::vector<std::string> memoBoxImagePaths(const char *markup)
{
	std::vector<std::string> paths;
	if (!markup)
		return paths;
	const std::string text = markup;
	size_t pos = 0;
	while ((pos = text.find(HREF_FILE, pos)) != std::string::npos) {
		const size_t start = pos + strlen(HREF_FILE);
		const size_t end = text.find(ITEM_END, start);
		if (end == std::string::npos)
			break;
		size_t stop = text.find_first_of(" >", start);
		if (stop == std::string::npos || stop > end)
			stop = end;
		std::string path = text.substr(start, stop - start);
		if (path.size() >= MEMO_BOX_IMAGE_PATH_BUFFER)
			path.resize(MEMO_BOX_IMAGE_PATH_BUFFER - 1);
		paths.push_back(path);
		pos = end + strlen(ITEM_END);
	}
	return paths;
}

bool memoBoxImageEraseByPath(std::string &markup, const char *path)
{
	return eraseBetween(markup, path, "<item", "></item>");
}

bool memoBoxImageEraseTag(std::string &markup, const char *path)
{
	return eraseBetween(markup, path, "<item size", ITEM_END);
}
