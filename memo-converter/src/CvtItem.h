#ifndef MEMO_CONVERTER_SRC_CVTITEM_H
#define MEMO_CONVERTER_SRC_CVTITEM_H

#include <string>
#include <vector>

// One item of a memo body as the converter holds it.
struct CvtItem {
	bool isCheck = false;
	bool checked = false;
	std::string markup; // the item's entry markup, not XML-escaped
};

typedef std::vector<CvtItem> CvtItemList;

#endif
