#ifndef INC_DATABASE_MEMOTEXT_H
#define INC_DATABASE_MEMOTEXT_H

#include <atomic>
#include <cstddef>

// An immutable text that copies share: the records of every list read made from the same rows hold one copy
// of each column's text between them. It may also be null, as an SQL NULL is; c_str() then gives "".
class MemoText
{
public:
	MemoText() : __block(nullptr) {}
	// A copy of text (null stays null).
	explicit MemoText(const char *text);
	MemoText(const char *text, size_t length);
	MemoText(const MemoText &other) : __block(other.__block) { __ref(); }
	MemoText(MemoText &&other) noexcept : __block(other.__block) { other.__block = nullptr; }
	MemoText &operator=(const MemoText &other);
	MemoText &operator=(MemoText &&other) noexcept;
	MemoText &operator=(const char *text) { return *this = MemoText(text); }
	~MemoText() { __unref(); }

	bool isNull() const { return !__block; }
	const char *c_str() const { return __block ? __block->text : ""; }
	size_t length() const { return __block ? __block->length : 0; }
	bool empty() const { return length() == 0; }

private:
	struct Block {
		std::atomic<int> refs;
		size_t length;
		char text[1];
	};
	void __ref() const
	{
		if (__block)
			__block->refs.fetch_add(1, std::memory_order_relaxed);
	}
	void __unref();
	MemoText(const char *text, size_t length, bool);
	void __make(const char *text, size_t length);

	Block *__block;
};

#endif
