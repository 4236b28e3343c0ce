#ifndef INC_BOX_MEMOBOXITEMTYPE_H
#define INC_BOX_MEMOBOXITEMTYPE_H

// The kinds of box item. An item's kind may change while it lives; the head of the body list
// has a first kind (FIRST_CHECK, FIRST_TEXT or QUICK_TEXT) and no other item has.
enum _MemoBoxItemType {
	MEMO_BOX_ITEM_TEXT = 0,
	MEMO_BOX_ITEM_CHECK = 1,
	MEMO_BOX_ITEM_FIRST_CHECK = 2,
	MEMO_BOX_ITEM_TITLE = 3,
	MEMO_BOX_ITEM_QUICK_TITLE = 4,
	MEMO_BOX_ITEM_FIRST_TEXT = 5,
	MEMO_BOX_ITEM_QUICK_TEXT = 6,
};

// True for the two check kinds, which the todolist document stores as type "1".
inline bool memoBoxItemIsCheck(_MemoBoxItemType type)
{
	return type == MEMO_BOX_ITEM_CHECK || type == MEMO_BOX_ITEM_FIRST_CHECK;
}

#endif
