#include "DataBase/MemoText.h"

#include <cstring>
#include <new>

namespace
{
const size_t CHUNK_BYTES = 256 * 1024;
const size_t SHORT_BYTES = 24;
} // namespace

MemoText::MemoText(const char *text) : MemoText(text, text ? strlen(text) : 0) {}

MemoText::MemoText(const char *text, size_t length) : __bits(0)
{
	if (!text)
		return;
	if (length == 0) { // one empty text for all
		static const MemoText empty = [] {
			MemoText made;
			made.__make("", 0);
			return made;
		}();
		*this = empty;
		return;
	}
	__make(text, length);
}

void MemoText::__make(const char *text, size_t length)
{
	// The block is built whole, so a short text still takes at least the block's own size.
	const size_t bytes = offsetof(Block, text) + length + 1;
	void *memory = ::operator new(bytes > sizeof(Block) ? bytes : sizeof(Block));
	Block *block = new (memory) Block{{1}, static_cast<uint32_t>(length), {}};
	memcpy(block->text, text, length);
	block->text[length] = '\0';
	__bits = reinterpret_cast<uintptr_t>(block);
}

MemoText &MemoText::operator=(const MemoText &other)
{
	other.__ref();
	__unref();
	__bits = other.__bits;
	return *this;
}

MemoText &MemoText::operator=(MemoText &&other) noexcept
{
	if (this != &other) {
		__unref();
		__bits = other.__bits;
		other.__bits = 0;
	}
	return *this;
}

void MemoText::__unref()
{
	if (__counted() && __block()->refs.fetch_sub(1, std::memory_order_acq_rel) == 1) {
		Block *block = __block();
		block->~Block();
		::operator delete(block);
	}
	__bits = 0;
}

MemoText MemoTextArena::add(const char *text)
{
	if (!text)
		return MemoText();
	const size_t length = strlen(text);
	if (length > SHORT_BYTES)
		return __store(text, length);
	auto found = __short.find(std::string_view(text, length));
	if (found != __short.end())
		return found->second;
	MemoText stored = __store(text, length);
	__short.emplace(std::string_view(stored.c_str(), length), stored);
	return stored;
}

MemoText MemoTextArena::__store(const char *text, size_t length)
{
	// Blocks stay aligned for their counter, which leaves the lowest bit of their address free.
	const size_t bytes = (offsetof(MemoText::Block, text) + length + 1 + 7) & ~static_cast<size_t>(7);
	if (__used + bytes > __size) {
		__size = bytes > CHUNK_BYTES / 4 ? bytes : CHUNK_BYTES;
		__chunks.emplace_back(new char[__size]);
		__used = 0;
	}
	char *memory = __chunks.back().get() + __used;
	__used += bytes;
	MemoText::Block *block = new (memory) MemoText::Block{{0}, static_cast<uint32_t>(length), {}};
	memcpy(block->text, text, length);
	block->text[length] = '\0';
	MemoText result;
	result.__bits = reinterpret_cast<uintptr_t>(block) | MemoText::BORROWED;
	return result;
}
