#ifndef MEMO_CONVERTER_SRC_CVTEXCHANGEXML_H
#define MEMO_CONVERTER_SRC_CVTEXCHANGEXML_H

#include "CvtItem.h"

#include <string>

// The exchange document of a body (layout in MemoCvt.h). Always a well-formed document.
std::string cvtExchangeXml(const CvtItemList &items);

#endif
