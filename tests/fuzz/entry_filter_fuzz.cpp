// Fuzz target: pasted markup through the text steps of the body entry filter, with any picture count
// the memo may report, and the tag helpers on every picture tag that comes out.
// fuzz-sources: src/Box/MemoEntryFilterMarkup.cpp src/Util/MemoUtilText.cpp
#include "Box/MemoEntryFilterTags.h"

#include <cstdint>
#include <cstdlib>
#include <string>

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, size_t size)
{
	if (size == 0)
		return 0;
	const int images = data[0] % 14 - 2; // -2 .. 11: none, some, the limit and past it
	const std::string text(reinterpret_cast<const char *>(data + 1), size - 1);
	const std::string out = memoEntryFilterMarkup(text.c_str(), [images] { return images; });
	if (out.find('\n') != std::string::npos)
		abort();
	for (size_t pos = out.find("<item"); pos != std::string::npos; pos = out.find("<item", pos + 1)) {
		std::string tag = out.substr(pos, memoFilterTagEnd(out, pos) - pos);
		int width = 0, height = 0;
		if (memoFilterTagSize(tag, &width, &height))
			memoFilterTagSetSize(tag, width / 2, height / 2);
		if (!memoFilterTagPath(tag).empty()) {
			memoFilterTagSetPath(tag, "/media/x.jpg");
			if (memoFilterTagPath(tag) != "/media/x.jpg")
				abort();
		}
	}
	return 0;
}
