#include "CvtExchangeXml.h"

#include "CvtLog.h"
#include "CvtMarkup.h"
#include "CvtUtf8.h"

#include <libxml/xmlwriter.h>

namespace
{
const char EMPTY_DOCUMENT[] = "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<memo version=\"1\"/>\n";

int __writeRun(xmlTextWriterPtr writer, const CvtRun &run)
{
	int rc;
	switch (run.kind) {
	case CvtRun::TEXT:
		return xmlTextWriterWriteString(writer, BAD_CAST cvtValidUtf8(run.text, CVT_XML_REPLACE).c_str());
	case CvtRun::BREAK:
		rc = xmlTextWriterStartElement(writer, BAD_CAST "br");
		return rc < 0 ? rc : xmlTextWriterEndElement(writer);
	case CvtRun::IMAGE:
		rc = xmlTextWriterStartElement(writer, BAD_CAST "image");
		if (rc >= 0)
			rc = xmlTextWriterWriteAttribute(writer, BAD_CAST "href",
			                                 BAD_CAST cvtValidUtf8(run.text, CVT_XML_REPLACE).c_str());
		if (rc >= 0)
			rc = xmlTextWriterWriteFormatAttribute(writer, BAD_CAST "width", "%d", run.width);
		if (rc >= 0)
			rc = xmlTextWriterWriteFormatAttribute(writer, BAD_CAST "height", "%d", run.height);
		return rc < 0 ? rc : xmlTextWriterEndElement(writer);
	}
	return 0;
}

int __writeItem(xmlTextWriterPtr writer, const CvtItem &item)
{
	int rc = xmlTextWriterWriteRaw(writer, BAD_CAST "\n");
	if (rc >= 0)
		rc = xmlTextWriterStartElement(writer, BAD_CAST "item");
	if (rc >= 0)
		rc = xmlTextWriterWriteAttribute(writer, BAD_CAST "type", BAD_CAST(item.isCheck ? "check" : "text"));
	if (rc >= 0)
		rc = xmlTextWriterWriteAttribute(writer, BAD_CAST "checked",
		                                 BAD_CAST(item.isCheck && item.checked ? "true" : "false"));
	const std::vector<CvtRun> runs = cvtParseMarkup(item.markup);
	for (size_t i = 0; rc >= 0 && i < runs.size(); ++i)
		rc = __writeRun(writer, runs[i]);
	if (rc >= 0)
		rc = xmlTextWriterFullEndElement(writer);
	return rc;
}

int __writeDocument(xmlTextWriterPtr writer, const CvtItemList &items)
{
	int rc = xmlTextWriterStartDocument(writer, "1.0", "UTF-8", nullptr);
	if (rc >= 0)
		rc = xmlTextWriterStartElement(writer, BAD_CAST "memo");
	if (rc >= 0)
		rc = xmlTextWriterWriteAttribute(writer, BAD_CAST "version", BAD_CAST "1");
	for (size_t i = 0; rc >= 0 && i < items.size(); ++i)
		rc = __writeItem(writer, items[i]);
	if (rc >= 0 && !items.empty())
		rc = xmlTextWriterWriteRaw(writer, BAD_CAST "\n");
	if (rc >= 0)
		rc = xmlTextWriterEndElement(writer);
	if (rc >= 0)
		rc = xmlTextWriterEndDocument(writer);
	return rc;
}
} // namespace

std::string cvtExchangeXml(const CvtItemList &items)
{
	if (items.empty())
		return EMPTY_DOCUMENT;
	xmlBufferPtr buffer = xmlBufferCreate();
	xmlTextWriterPtr writer = buffer ? xmlNewTextWriterMemory(buffer, 0) : nullptr;
	if (!writer) {
		CVT_LOGE("exchange writer could not be made");
		if (buffer)
			xmlBufferFree(buffer);
		return EMPTY_DOCUMENT;
	}
	const int rc = __writeDocument(writer, items);
	xmlFreeTextWriter(writer);
	std::string result;
	if (rc < 0)
		CVT_LOGE("exchange writer failed (%d)", rc);
	else
		result = reinterpret_cast<const char *>(xmlBufferContent(buffer));
	xmlBufferFree(buffer);
	return result.empty() ? EMPTY_DOCUMENT : result;
}
