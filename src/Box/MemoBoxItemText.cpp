// Small string helpers of the box item files.
#include "MemoBoxItemPrivate.h"

void memoBoxReplaceAll(std::string &text, const std::string &from, const std::string &to)
{
	if (from.empty())
		return;
	size_t pos = 0;
	while ((pos = text.find(from, pos)) != std::string::npos) {
		text.replace(pos, from.size(), to);
		pos += to.size();
	}
}

bool memoBoxStartsWith(const std::string &text, const std::string &piece)
{
	return text.size() >= piece.size() && text.compare(0, piece.size(), piece) == 0;
}

bool memoBoxEndsWith(const std::string &text, const std::string &piece)
{
	return text.size() >= piece.size() && text.compare(text.size() - piece.size(), piece.size(), piece) == 0;
}
