#ifndef PLATFORM_SRC_UI_UXT_THEME_TABLES_H
#define PLATFORM_SRC_UI_UXT_THEME_TABLES_H

/* Parsing and applying of the colour and font table files (format in uxt_theme.h). */
#include <libxml/tree.h>
#include <uxt_theme.h>

/* Parsed tables; NULL (logged) when the file cannot be read or holds no usable entry. */
Uxt_Theme_Color_Table *uxt_color_table_load(const char *path);
Uxt_Theme_Font_Table *uxt_font_table_load(const char *path);
void uxt_color_table_free(Uxt_Theme_Color_Table *table);
void uxt_font_table_free(Uxt_Theme_Font_Table *table);

/* Sets the Edje colour classes of the style chosen by the theme key; returns how many were set. */
int uxt_color_table_apply(const Uxt_Theme_Color_Table *table);

/* Sets the Edje text classes, scaled by the font size key; returns how many were set. */
int uxt_font_table_apply(const Uxt_Theme_Font_Table *table);

/* Parses a file into a tree; NULL (logged) on failure. The caller frees it with xmlFreeDoc. */
xmlDocPtr uxt_xml_read(const char *path);

/* Reads an integer attribute; EINA_FALSE if absent or not a number. */
Eina_Bool uxt_xml_int_attr(xmlNodePtr node, const char *name, int *value);

/* A malloc'ed copy of a text attribute, or NULL if absent. */
char *uxt_xml_str_attr(xmlNodePtr node, const char *name);

#endif
