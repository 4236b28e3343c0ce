#ifndef __EEXT_FLOATINGBUTTON_H__
#define __EEXT_FLOATINGBUTTON_H__

#include <Elementary.h>

#ifdef __cplusplus
extern "C" {
#endif

typedef enum {
	EEXT_FLOATINGBUTTON_LEFT_OUT = 0,
	EEXT_FLOATINGBUTTON_LEFT,
	EEXT_FLOATINGBUTTON_CENTER,
	EEXT_FLOATINGBUTTON_RIGHT,
	EEXT_FLOATINGBUTTON_RIGHT_OUT,
	EEXT_FLOATINGBUTTON_LAST,
} Eext_Floatingbutton_Pos;

typedef enum {
	EEXT_FLOATINGBUTTON_MODE_DEFAULT = 0,
	EEXT_FLOATINGBUTTON_MODE_BOTH_SIDES,
	EEXT_FLOATINGBUTTON_MODE_LAST,
} Eext_Floatingbutton_Mode;

/* A layout holding up to two buttons in the parts "button1" and "button2", placed at one of five stops
   (RIGHT at first). The parent owns it. Returns NULL (logged) on a null parent. */
Evas_Object *eext_floatingbutton_add(Evas_Object *parent);

/* DEFAULT allows all five stops; BOTH_SIDES only LEFT and RIGHT (a button on another stop moves to RIGHT). */
void eext_floatingbutton_mode_set(Evas_Object *obj, Eext_Floatingbutton_Mode mode);
Eext_Floatingbutton_Mode eext_floatingbutton_mode_get(const Evas_Object *obj);

/* Moves the button to a stop; EINA_FALSE (logged) if the stop is not allowed in the current mode. */
Eina_Bool eext_floatingbutton_pos_set(Evas_Object *obj, Eext_Floatingbutton_Pos pos);
Eext_Floatingbutton_Pos eext_floatingbutton_pos_get(const Evas_Object *obj);

#ifdef __cplusplus
}
#endif

#endif
