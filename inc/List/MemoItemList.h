#ifndef INC_LIST_MEMOITEMLIST_H
#define INC_LIST_MEMOITEMLIST_H

#include <vector>

class MemoDocInfo;

// The owning list of memo records that every list read of the store returns.
// Deleting the list deletes its records. Reading by index costs the same for every index, so
// walking a list of ten thousand memos stays linear.
class MemoItemList
{
public:
	MemoItemList();
	virtual ~MemoItemList();

	// Appends the record and takes ownership of it; a null record logs "input is NULL".
	void appendItem(MemoDocInfo *item);
	// Returns the record at index (still owned by the list), or null; an empty list
	// logs "__list is NULL".
	MemoDocInfo *getItem(int index);
	// Returns the number of records; an empty list logs "__list is NULL" and gives 0.
	int getCount();

private:
	MemoItemList(const MemoItemList &) = delete;
	MemoItemList &operator=(const MemoItemList &) = delete;
	void __clearList();

	std::vector<MemoDocInfo *> __list;
};

#endif
