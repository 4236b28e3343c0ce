#ifndef __EFL_ASSIST_THEME_H__
#define __EFL_ASSIST_THEME_H__

#include <Elementary.h>

#ifdef __cplusplus
extern "C" {
#endif

typedef enum {
	EA_THEME_STYLE_DEFAULT,
	EA_THEME_STYLE_DARK,
	EA_THEME_STYLE_LIGHT,
} Ea_Theme_Style;

typedef enum {
	EA_THEME_CALLBACK_TYPE_COLOR,
	EA_THEME_CALLBACK_TYPE_FONT,
} Ea_Theme_Callback_Type;

/* Reads the colour class code as obj's Edje (or its layout's Edje) sees it, falling back to the global
   colour class: the main colour, outline and shadow; any output pointer may be NULL. EINA_FALSE (logged)
   on a null obj or code or an unknown class. */
Eina_Bool ea_theme_object_color_get(Evas_Object *obj, const char *code, int *r, int *g, int *b, int *a, int *r2,
                                    int *g2, int *b2, int *a2, int *r3, int *g3, int *b3, int *a3);

#ifdef __cplusplus
}
#endif

#endif
