#include "DataBase/MemoText.h"

#include <cstring>
#include <new>

MemoText::MemoText(const char *text) : MemoText(text, text ? strlen(text) : 0) {}

MemoText::MemoText(const char *text, size_t length) : __block(nullptr)
{
	if (!text)
		return;
	if (length == 0) { // one empty text for all
		static const MemoText empty("", 0, true);
		*this = empty;
		return;
	}
	__make(text, length);
}

MemoText::MemoText(const char *text, size_t length, bool) : __block(nullptr)
{
	__make(text, length);
}

void MemoText::__make(const char *text, size_t length)
{
	void *memory = ::operator new(offsetof(Block, text) + length + 1);
	__block = new (memory) Block{{1}, length, {}};
	memcpy(__block->text, text, length);
	__block->text[length] = '\0';
}

MemoText &MemoText::operator=(const MemoText &other)
{
	other.__ref();
	__unref();
	__block = other.__block;
	return *this;
}

MemoText &MemoText::operator=(MemoText &&other) noexcept
{
	if (this != &other) {
		__unref();
		__block = other.__block;
		other.__block = nullptr;
	}
	return *this;
}

void MemoText::__unref()
{
	if (__block && __block->refs.fetch_sub(1, std::memory_order_acq_rel) == 1) {
		__block->~Block();
		::operator delete(__block);
	}
	__block = nullptr;
}
