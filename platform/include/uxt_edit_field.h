#ifndef __UXT_EDIT_FIELD_H__
#define __UXT_EDIT_FIELD_H__

#include <Elementary.h>

#ifdef __cplusplus
extern "C" {
#endif

/* Edit field kinds; uxt_edit_field_add takes these values as int. */
typedef enum {
	UXT_EDIT_FIELD_SINGLELINE = 0,
	UXT_EDIT_FIELD_MULTILINE,
	UXT_EDIT_FIELD_SCROLL_SINGLELINE,
	UXT_EDIT_FIELD_SCROLL_MULTILINE,
	UXT_EDIT_FIELD_SCROLL_SINGLELINE_PASSWORD,
	UXT_EDIT_FIELD_SEARCHBAR,
	UXT_EDIT_FIELD_LAST,
} Uxt_Edit_Field_Type;

/* An elm_entry configured for the kind (line mode, scrolling, password, return key). Single-line kinds carry
   a clear button in "elm.swallow.clear" when the entry style has it, else in "elm.swallow.end"; it shows while
   the entry has text and empties it on click. The parent owns the entry. NULL (logged) on a null parent or
   an unknown kind. */
Evas_Object *uxt_edit_field_add(Evas_Object *parent, int type);

#ifdef __cplusplus
}
#endif

#endif
