#ifndef INC_DATABASE_MEMOTEXT_H
#define INC_DATABASE_MEMOTEXT_H

#include <atomic>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <string_view>
#include <unordered_map>
#include <vector>

// An immutable text that copies share. It may be null, as an SQL NULL is; c_str() then gives "".
// A text made by a MemoTextArena is borrowed from it: copies cost nothing and count nothing, and whatever
// holds one must keep the arena alive (records read from the same rows share their texts this way).
class MemoText
{
public:
	MemoText() : __bits(0) {}
	// A copy of text (null stays null).
	explicit MemoText(const char *text);
	MemoText(const char *text, size_t length);
	MemoText(const MemoText &other) : __bits(other.__bits) { __ref(); }
	MemoText(MemoText &&other) noexcept : __bits(other.__bits) { other.__bits = 0; }
	MemoText &operator=(const MemoText &other);
	MemoText &operator=(MemoText &&other) noexcept;
	~MemoText() { __unref(); }

	bool isNull() const { return !__bits; }
	const char *c_str() const { return __bits ? __block()->text : ""; }
	size_t length() const { return __bits ? __block()->length : 0; }
	bool empty() const { return length() == 0; }

private:
	friend class MemoTextArena;
	struct Block {
		std::atomic<int> refs; // not used by a borrowed text
		uint32_t length;
		char text[1];
	};
	static const uintptr_t BORROWED = 1;

	Block *__block() const { return reinterpret_cast<Block *>(__bits & ~BORROWED); }
	bool __counted() const { return __bits && !(__bits & BORROWED); }
	void __ref() const
	{
		if (__counted())
			__block()->refs.fetch_add(1, std::memory_order_relaxed);
	}
	void __unref();
	void __make(const char *text, size_t length);

	uintptr_t __bits; // a Block, its lowest bit set when borrowed
};

// Texts stored together and freed together, in a few large chunks. Short texts that repeat (colours, titles,
// empty columns) are stored once.
class MemoTextArena
{
public:
	MemoTextArena() = default;
	MemoTextArena(const MemoTextArena &) = delete;
	MemoTextArena &operator=(const MemoTextArena &) = delete;

	// A copy of text (null stays null) borrowed from the arena.
	MemoText add(const char *text);

private:
	MemoText __store(const char *text, size_t length);

	std::unordered_map<std::string_view, MemoText> __short;
	std::vector<std::unique_ptr<char[]>> __chunks;
	size_t __used = 0;
	size_t __size = 0;
};

#endif
