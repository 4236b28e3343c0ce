#ifndef __UXT_THEME_H__
#define __UXT_THEME_H__

/* Changeable colour and font tables, applied as Edje colour classes and text classes.

   Colour table file (XML):
     <ChangeableColorTables>
       <ChangeableColorTable num="1">
         <Theme style="Light">
           <ChangeableColorInfo id="B011" r="250" g="250" b="250" a="255"/>
           <ChangeableColorInfo id="T022" r="0" g="0" b="0" a="255" r2="255" g2="255" b2="255" a2="0"/>
         </Theme>
         <Theme style="Dark"> ... </Theme>
       </ChangeableColorTable>
     </ChangeableColorTables>
   Each entry gives the final colour of the class "id": r g b a (0..255, a defaults to 255), optionally the
   outline r2 g2 b2 a2 and the shadow r3 g3 b3 a3 (both default to 0 0 0 0). Entries without r, g and b are
   skipped with a log line. Only the first ChangeableColorTable is used. The style comes from the vconf key
   "db/setting/change_ui/theme": 1 picks "Dark", any other value (or no key) "Light"; a table without that
   style falls back to its first Theme.

   Font table file (XML):
     <FontInfoTable>
       <FontInfo id="T011" typeface="Sans" style="R" size="38"/>
       <FontInfo id="T012" typeface="Sans" style="B" size="30" fixed="1"/>
     </FontInfoTable>
   Each entry sets the text class "id" to the font "<typeface>:style=<Style>" (style L Light, R Regular,
   M Medium, B Bold, or a full style name; default Regular; typeface defaults to "Sans") and the size times the
   factor of "db/setting/accessibility/font_size" (0 small 0.8, 1 normal 1.0, 2 large 1.2, 3 huge 1.5,
   4 giant 1.9; default normal), unless fixed="1".

   While changeable UI is enabled, a change of either key re-applies the last tables set and then runs the
   changed callbacks of that kind (theme key: colour, font size key: font). */
#include <Elementary.h>
#include <uxt_error.h>

#ifdef __cplusplus
extern "C" {
#endif

typedef struct _Uxt_Theme_Color_Table Uxt_Theme_Color_Table;
typedef struct _Uxt_Theme_Font_Table Uxt_Theme_Font_Table;

/* Kinds of changed callback; the int parameters below take these values. */
typedef enum {
	UXT_THEME_CHANGED_TYPE_COLOR = 0,
	UXT_THEME_CHANGED_TYPE_FONT = 1,
} Uxt_Theme_Changed_Type;

/* event_info is the Uxt_Theme_Changed_Type that changed, cast to a pointer; data is the registered data. */
typedef void (*Uxt_Theme_Changed_Cb)(void *event_info, void *data);

/* Starts (or stops) following the theme and font size keys. */
int uxt_theme_set_changeable_ui_enabled(Eina_Bool enabled);

/* Parses a colour table file. Returns a new table the caller frees with uxt_theme_delete_color_table,
   or NULL (logged) on a null path or an unreadable or empty file. */
Uxt_Theme_Color_Table *uxt_theme_add_color_table(const char *file_path);

/* Sets every colour class of the table for the current style and remembers the table for re-applying. */
int uxt_theme_set_color_table(Uxt_Theme_Color_Table *table);

/* Frees the table (the colour classes stay as set). */
int uxt_theme_delete_color_table(Uxt_Theme_Color_Table *table);

/* Font equivalents of the three calls above. */
Uxt_Theme_Font_Table *uxt_theme_add_font_table(const char *file_path);
int uxt_theme_set_font_table(Uxt_Theme_Font_Table *table);
int uxt_theme_delete_font_table(Uxt_Theme_Font_Table *table);

/* Registers func for a kind of change (UXT_THEME_CHANGED_TYPE_*). */
int uxt_theme_add_changed_callback(int type, Uxt_Theme_Changed_Cb func, void *data);

/* Removes the registration of func for that kind; UXT_ERROR_NO_DATA if none. */
int uxt_theme_delete_changed_callback(int type, Uxt_Theme_Changed_Cb func);

/* Makes the colour class code of obj's Edje (or its layout's) show the current colour of new_code. */
int uxt_theme_object_replace_color(Evas_Object *obj, const char *code, const char *new_code);

#ifdef __cplusplus
}
#endif

#endif
