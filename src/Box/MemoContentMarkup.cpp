#include "Box/MemoContentMarkup.h"

#include <cstdlib>
#include <cstring>

namespace
{
bool __isFormatTag(const char *tag)
{
	const char c = tag[1];
	if (c == 'c' || c == 'a' || c == 'u')
		return true;
	return c == '/' && (tag[2] == 'c' || tag[2] == 'a');
}
} // namespace

char *memoSavedMarkupN(const char *entryMarkup)
{
	if (!entryMarkup)
		return strdup("");
	const size_t len = strlen(entryMarkup);
	char *out = static_cast<char *>(malloc(len + 1));
	if (!out)
		return nullptr;
	size_t o = 0;
	size_t i = 0;
	while (i < len) {
		if (entryMarkup[i] == '<') {
			if (len - i - 1 < 2)
				break;
			if (__isFormatTag(entryMarkup + i)) {
				const char *close = strchr(entryMarkup + i, '>');
				i = close ? static_cast<size_t>(close - entryMarkup) + 1 : len;
				continue;
			}
		}
		out[o++] = entryMarkup[i++];
	}
	out[o] = '\0';
	return out;
}
