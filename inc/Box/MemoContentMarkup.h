#ifndef INC_BOX_MEMOCONTENTMARKUP_H
#define INC_BOX_MEMOCONTENTMARKUP_H

// The saved markup of a box item (MemoBoxItem::getContentMarkupN): the entry's markup with its
// format tags removed in one left-to-right pass. A tag runs from "<" to the next ">" (or to the
// end); it goes when it starts "<c", "<a", "<u", "</c" or "</a". So "<underline=on>" goes while
// "</underline>" stays, and "<item ...>", "</item>" and "<br/>" stay. The pass ends, dropping
// the rest, at the first "<" with fewer than two characters behind it.
// Returns a new string the caller frees; null input gives "".
char *memoSavedMarkupN(const char *entryMarkup);

#endif
