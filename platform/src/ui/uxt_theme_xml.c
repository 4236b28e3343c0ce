#include "ui/uxt_theme_tables.h"

#include <dlog.h>
#include <errno.h>
#include <libxml/parser.h>
#include <stdlib.h>
#include <string.h>

xmlDocPtr uxt_xml_read(const char *path)
{
	xmlDocPtr doc = xmlReadFile(path, NULL, XML_PARSE_NONET | XML_PARSE_NOERROR | XML_PARSE_NOWARNING);
	if (!doc)
		LOGE("cannot parse %s", path);
	return doc;
}

char *uxt_xml_str_attr(xmlNodePtr node, const char *name)
{
	xmlChar *value = xmlGetProp(node, (const xmlChar *)name);
	if (!value)
		return NULL;
	char *copy = strdup((const char *)value);
	xmlFree(value);
	return copy;
}

Eina_Bool uxt_xml_int_attr(xmlNodePtr node, const char *name, int *value)
{
	char *text = uxt_xml_str_attr(node, name);
	if (!text)
		return EINA_FALSE;
	char *end = NULL;
	errno = 0;
	long number = strtol(text, &end, 10);
	Eina_Bool ok = end != text && *end == '\0' && errno == 0 && number >= -100000 && number <= 100000;
	free(text);
	if (ok)
		*value = (int)number;
	return ok;
}
