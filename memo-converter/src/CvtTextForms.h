#ifndef MEMO_CONVERTER_SRC_CVTTEXTFORMS_H
#define MEMO_CONVERTER_SRC_CVTTEXTFORMS_H

#include "CvtItem.h"

#include <string>

// The text forms of a body; their layout is documented in MemoCvt.h. All return valid UTF-8.
std::string cvtContentText(const CvtItemList &items);
std::string cvtDisplayText(const CvtItemList &items);
std::string cvtStrippedText(const CvtItemList &items);

#endif
