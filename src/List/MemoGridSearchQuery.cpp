// The store's search of a search grid, skipped where its result is known already: a text that cannot match
// while the store is unchanged.
#include "List/MemoGridControl.h"

#include <cstring>

#include <app_i18n.h>

#include "DataBase/MemoDbMgr.h"

namespace
{
// The store matches the quick memo by this translated header as well: a new language may match new texts.
std::string quickMemoHeader()
{
	const char *header = i18n_get_text("IDS_MEMO_HEADER_QUICK_MEMO");
	return header ? header : "";
}
} // namespace

// A text that holds the text of the last search, which matched nothing, matches nothing either while the
// store is unchanged: the pattern is '%text%' with "/" as the escape, so when the earlier text holds none of
// "%", "_" and "/" it stands for itself inside the new one, and whatever holds the new text holds the earlier
// one (case folding included). The quick memo's words cannot match the longer text when they did not match its
// part, in the same language.
bool MemoGridControl::__searchCannotMatch(const char *keyword)
{
	if (!keyword || !__lastSearch.valid || __lastSearch.count != 0)
		return false;
	const std::string &before = __lastSearch.text;
	if (before.find_first_of("%_/") != std::string::npos || !strstr(keyword, before.c_str()))
		return false;
	return MemoDbMgr::getInstance()->getChangeStamp() == __lastSearch.stamp && quickMemoHeader() == __lastSearch.header;
}

void MemoGridControl::__keepSearch(const char *keyword, int count, bool ok, std::pair<long long, long long> stamp)
{
	__lastSearch.valid = ok && keyword;
	__lastSearch.text = keyword ? keyword : "";
	__lastSearch.count = count;
	__lastSearch.stamp = stamp;
	__lastSearch.header = quickMemoHeader();
}
