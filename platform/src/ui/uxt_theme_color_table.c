/* Colour tables: per style, a list of colour classes with their final main, outline and shadow colours. */
#include "ui/uxt_theme_tables.h"

#include <dlog.h>
#include <stdlib.h>
#include <string.h>
#include <strings.h>
#include <vconf.h>

typedef struct {
	char *id;
	int rgba[12]; /* main, outline, shadow */
} Color_Entry;

typedef struct {
	char *name;
	Eina_List *entries; /* Color_Entry */
} Color_Style;

struct _Uxt_Theme_Color_Table {
	Eina_List *styles; /* Color_Style, in file order */
};

static const char *const __channels[12] = {"r", "g", "b", "a", "r2", "g2", "b2", "a2", "r3", "g3", "b3", "a3"};

static int __clamp(int v)
{
	return v < 0 ? 0 : (v > 255 ? 255 : v);
}

static Color_Entry *__entryParse(xmlNodePtr node)
{
	char *id = uxt_xml_str_attr(node, "id");
	if (!id || !*id) {
		LOGE("colour entry without id (line %ld)", xmlGetLineNo(node));
		free(id);
		return NULL;
	}
	Color_Entry *entry = calloc(1, sizeof(*entry));
	if (!entry) {
		free(id);
		return NULL;
	}
	entry->id = id;
	entry->rgba[3] = 255;
	for (int i = 0; i < 12; i++) {
		int value;
		if (uxt_xml_int_attr(node, __channels[i], &value)) {
			entry->rgba[i] = __clamp(value);
		} else if (i < 3) {
			LOGE("colour %s has no valid %s; skipped", id, __channels[i]);
			free(entry->id);
			free(entry);
			return NULL;
		}
	}
	return entry;
}

static void __styleFree(Color_Style *style)
{
	Color_Entry *entry;
	EINA_LIST_FREE(style->entries, entry)
	{
		free(entry->id);
		free(entry);
	}
	free(style->name);
	free(style);
}

static Color_Style *__styleParse(xmlNodePtr themeNode)
{
	Color_Style *style = calloc(1, sizeof(*style));
	if (!style)
		return NULL;
	style->name = uxt_xml_str_attr(themeNode, "style");
	for (xmlNodePtr n = themeNode->children; n; n = n->next) {
		if (n->type != XML_ELEMENT_NODE || xmlStrcmp(n->name, (const xmlChar *)"ChangeableColorInfo"))
			continue;
		Color_Entry *entry = __entryParse(n);
		if (entry)
			style->entries = eina_list_append(style->entries, entry);
	}
	return style;
}

static xmlNodePtr __firstChild(xmlNodePtr parent, const char *name)
{
	for (xmlNodePtr n = parent->children; n; n = n->next) {
		if (n->type == XML_ELEMENT_NODE && !xmlStrcmp(n->name, (const xmlChar *)name))
			return n;
	}
	return NULL;
}

Uxt_Theme_Color_Table *uxt_color_table_load(const char *path)
{
	xmlDocPtr doc = uxt_xml_read(path);
	if (!doc)
		return NULL;
	xmlNodePtr root = xmlDocGetRootElement(doc);
	xmlNodePtr tableNode = NULL;
	if (root && !xmlStrcmp(root->name, (const xmlChar *)"ChangeableColorTable"))
		tableNode = root;
	else if (root && !xmlStrcmp(root->name, (const xmlChar *)"ChangeableColorTables"))
		tableNode = __firstChild(root, "ChangeableColorTable");

	Uxt_Theme_Color_Table *table = calloc(1, sizeof(*table));
	int total = 0;
	for (xmlNodePtr n = tableNode ? tableNode->children : NULL; table && n; n = n->next) {
		if (n->type != XML_ELEMENT_NODE || xmlStrcmp(n->name, (const xmlChar *)"Theme"))
			continue;
		Color_Style *style = __styleParse(n);
		if (!style)
			continue;
		total += (int)eina_list_count(style->entries);
		table->styles = eina_list_append(table->styles, style);
	}
	xmlFreeDoc(doc);
	if (table && total == 0) {
		LOGE("no colours in %s", path);
		uxt_color_table_free(table);
		return NULL;
	}
	return table;
}

void uxt_color_table_free(Uxt_Theme_Color_Table *table)
{
	if (!table)
		return;
	Color_Style *style;
	EINA_LIST_FREE(table->styles, style)
	__styleFree(style);
	free(table);
}

/* The theme key picks the style: 1 is dark, anything else light. */
static const char *__styleName(void)
{
	int theme = 0;
	if (vconf_get_int(VCONFKEY_SETAPPL_CHANGE_UI_THEME_INT, &theme) != VCONF_OK)
		theme = 0;
	return theme == 1 ? "Dark" : "Light";
}

int uxt_color_table_apply(const Uxt_Theme_Color_Table *table)
{
	if (!table || !table->styles)
		return 0;
	const char *wanted = __styleName();
	const Color_Style *chosen = eina_list_data_get(table->styles);
	const Eina_List *l;
	const Color_Style *style;
	EINA_LIST_FOREACH(table->styles, l, style)
	{
		if (style->name && !strcasecmp(style->name, wanted)) {
			chosen = style;
			break;
		}
	}
	int count = 0;
	const Color_Entry *e;
	EINA_LIST_FOREACH(chosen->entries, l, e)
	{
		const int *c = e->rgba;
		if (edje_color_class_set(e->id, c[0], c[1], c[2], c[3], c[4], c[5], c[6], c[7], c[8], c[9], c[10], c[11]))
			count++;
		else
			LOGE("cannot set colour class %s", e->id);
	}
	LOGI("%d colour classes set (style %s)", count, chosen->name ? chosen->name : "?");
	return count;
}
