/* Colour codes as seen by one object: an Edje colour class of the object's own Edje (a layout's or
   widget's theme object) with the process-wide class behind it. */
#include <efl_assist_theme.h>
#include <uxt_theme.h>

#include <canvas/efl_canvas_group.eo.h>
#include <dlog.h>
#include <string.h>

/* The object itself if it is an Edje object, else the Edje that an Elementary widget draws with. */
static Evas_Object *__edjeOf(Evas_Object *obj)
{
	const char *type = evas_object_type_get(obj);
	if (type && !strcmp(type, "edje"))
		return obj;
	if (!efl_isa(obj, EFL_CANVAS_GROUP_CLASS))
		return NULL; /* a primitive has no members, and asking makes Evas log an error */
	Eina_List *members = evas_object_smart_members_get(obj);
	Evas_Object *edje = NULL;
	Eina_List *l;
	Evas_Object *member;
	EINA_LIST_FOREACH(members, l, member)
	{
		type = evas_object_type_get(member);
		if (type && !strcmp(type, "edje")) {
			edje = member;
			break;
		}
	}
	eina_list_free(members);
	return edje;
}

static void __store(int *out, int value)
{
	if (out)
		*out = value;
}

Eina_Bool ea_theme_object_color_get(Evas_Object *obj, const char *code, int *r, int *g, int *b, int *a, int *r2,
                                    int *g2, int *b2, int *a2, int *r3, int *g3, int *b3, int *a3)
{
	if (!obj || !code) {
		LOGE("invalid parameter: obj %p, code %s", (void *)obj, code ? code : "NULL");
		return EINA_FALSE;
	}
	int c[12] = {0};
	Evas_Object *edje = __edjeOf(obj);
	Eina_Bool found = edje && edje_object_color_class_get(edje, code, &c[0], &c[1], &c[2], &c[3], &c[4], &c[5], &c[6],
	                                                      &c[7], &c[8], &c[9], &c[10], &c[11]);
	if (!found)
		found = edje_color_class_get(code, &c[0], &c[1], &c[2], &c[3], &c[4], &c[5], &c[6], &c[7], &c[8], &c[9], &c[10],
		                             &c[11]);
	if (!found) {
		LOGE("no colour class %s", code);
		return EINA_FALSE;
	}
	int *outs[12] = {r, g, b, a, r2, g2, b2, a2, r3, g3, b3, a3};
	for (int i = 0; i < 12; i++)
		__store(outs[i], c[i]);
	return EINA_TRUE;
}

int uxt_theme_object_replace_color(Evas_Object *obj, const char *code, const char *new_code)
{
	if (!obj || !code || !new_code) {
		LOGE("invalid parameter: obj %p, code %s, new_code %s", (void *)obj, code ? code : "NULL",
		     new_code ? new_code : "NULL");
		return UXT_ERROR_INVALID_PARAMETER;
	}
	Evas_Object *edje = __edjeOf(obj);
	if (!edje) {
		LOGE("%p has no theme object", (void *)obj);
		return UXT_ERROR_INVALID_PARAMETER;
	}
	int c[12];
	if (!ea_theme_object_color_get(obj, new_code, &c[0], &c[1], &c[2], &c[3], &c[4], &c[5], &c[6], &c[7], &c[8], &c[9],
	                               &c[10], &c[11]))
		return UXT_ERROR_NO_DATA;
	if (!edje_object_color_class_set(edje, code, c[0], c[1], c[2], c[3], c[4], c[5], c[6], c[7], c[8], c[9], c[10],
	                                 c[11])) {
		LOGE("cannot set colour class %s", code);
		return UXT_ERROR_INVALID_OPERATION;
	}
	return UXT_ERROR_NONE;
}
