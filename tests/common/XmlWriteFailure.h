#ifndef TESTS_COMMON_XMLWRITEFAILURE_H
#define TESTS_COMMON_XMLWRITEFAILURE_H

// While one of these lives every libxml2 allocation fails, so that an XML writer fails the way it
// does when memory runs out. Only for code that reaches libxml2 on the test's own thread.

#include <libxml/parser.h>
#include <libxml/xmlmemory.h>

namespace memo_test
{
class XmlWriteFailure
{
public:
	XmlWriteFailure()
	{
		xmlInitParser();
		xmlMemGet(&__free, &__malloc, &__realloc, &__strdup);
		xmlMemSetup(__free, failMalloc, failRealloc, failStrdup);
	}
	~XmlWriteFailure() { xmlMemSetup(__free, __malloc, __realloc, __strdup); }

private:
	static void *failMalloc(size_t) { return nullptr; }
	static void *failRealloc(void *, size_t) { return nullptr; }
	static char *failStrdup(const char *) { return nullptr; }

	xmlFreeFunc __free = nullptr;
	xmlMallocFunc __malloc = nullptr;
	xmlReallocFunc __realloc = nullptr;
	xmlStrdupFunc __strdup = nullptr;
};
} // namespace memo_test

#endif
