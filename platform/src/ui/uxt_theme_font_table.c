/* Font tables: text classes with a font and a size that follows the accessibility font size. */
#include "ui/uxt_theme_tables.h"

#include <dlog.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <vconf.h>

typedef struct {
	char *id;
	char *font; /* "<typeface>:style=<Style>" */
	int size;
	Eina_Bool fixed;
} Font_Entry;

struct _Uxt_Theme_Font_Table {
	Eina_List *entries; /* Font_Entry */
};

static const char *__styleName(const char *style)
{
	if (!style || !*style)
		return "Regular";
	static const char *const abbrev[][2] = {
	    {"L", "Light"}, {"R", "Regular"}, {"M", "Medium"}, {"B", "Bold"}, {"T", "Thin"},
	};
	for (size_t i = 0; i < sizeof(abbrev) / sizeof(abbrev[0]); i++) {
		if (!strcmp(style, abbrev[i][0]))
			return abbrev[i][1];
	}
	return style;
}

static Font_Entry *__entryParse(xmlNodePtr node)
{
	char *id = uxt_xml_str_attr(node, "id");
	int size = 0;
	if (!id || !*id || !uxt_xml_int_attr(node, "size", &size) || size < 0) {
		LOGE("font entry %s without id or valid size; skipped", id ? id : "?");
		free(id);
		return NULL;
	}
	char *typeface = uxt_xml_str_attr(node, "typeface");
	char *style = uxt_xml_str_attr(node, "style");
	int fixed = 0;
	uxt_xml_int_attr(node, "fixed", &fixed);

	Font_Entry *entry = calloc(1, sizeof(*entry));
	const char *face = (typeface && *typeface) ? typeface : "Sans";
	const char *styleName = __styleName(style);
	size_t len = strlen(face) + strlen(styleName) + sizeof(":style=");
	char *font = malloc(len);
	if (entry && font) {
		snprintf(font, len, "%s:style=%s", face, styleName);
		entry->id = id;
		entry->font = font;
		entry->size = size;
		entry->fixed = fixed != 0;
		id = NULL;
		font = NULL;
	} else {
		free(entry);
		entry = NULL;
	}
	free(font);
	free(id);
	free(typeface);
	free(style);
	return entry;
}

Uxt_Theme_Font_Table *uxt_font_table_load(const char *path)
{
	xmlDocPtr doc = uxt_xml_read(path);
	if (!doc)
		return NULL;
	xmlNodePtr root = xmlDocGetRootElement(doc);
	Uxt_Theme_Font_Table *table = calloc(1, sizeof(*table));
	if (table && root && !xmlStrcmp(root->name, (const xmlChar *)"FontInfoTable")) {
		for (xmlNodePtr n = root->children; n; n = n->next) {
			if (n->type != XML_ELEMENT_NODE || xmlStrcmp(n->name, (const xmlChar *)"FontInfo"))
				continue;
			Font_Entry *entry = __entryParse(n);
			if (entry)
				table->entries = eina_list_append(table->entries, entry);
		}
	}
	xmlFreeDoc(doc);
	if (table && !table->entries) {
		LOGE("no fonts in %s", path);
		free(table);
		return NULL;
	}
	return table;
}

void uxt_font_table_free(Uxt_Theme_Font_Table *table)
{
	if (!table)
		return;
	Font_Entry *entry;
	EINA_LIST_FREE(table->entries, entry)
	{
		free(entry->id);
		free(entry->font);
		free(entry);
	}
	free(table);
}

/* Factor of the accessibility font size: small, normal, large, huge, giant. */
static double __sizeFactor(void)
{
	static const double factors[] = {0.8, 1.0, 1.2, 1.5, 1.9};
	int level = 1;
	if (vconf_get_int(VCONFKEY_SETAPPL_ACCESSIBILITY_FONT_SIZE, &level) != VCONF_OK || level < 0 || level > 4)
		level = 1;
	return factors[level];
}

int uxt_font_table_apply(const Uxt_Theme_Font_Table *table)
{
	if (!table)
		return 0;
	double factor = __sizeFactor();
	int count = 0;
	const Eina_List *l;
	const Font_Entry *e;
	EINA_LIST_FOREACH(table->entries, l, e)
	{
		int size = e->fixed ? e->size : (int)(e->size * factor + 0.5);
		if (edje_text_class_set(e->id, e->font, size))
			count++;
		else
			LOGE("cannot set text class %s", e->id);
	}
	LOGI("%d text classes set (size factor %.1f)", count, factor);
	return count;
}
