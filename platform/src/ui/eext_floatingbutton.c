/* The floating button: a layout from the platform's own floatingbutton.edj whose stop is switched by signals. */
#include <desktop/app_install.h>
#include <efl_extension.h>

#include <dlog.h>
#include <limits.h>
#include <stdio.h>
#include <stdlib.h>

#define FB_GROUP "eext/floatingbutton"
#define FB_DATA_KEY "__eext_floatingbutton"

typedef struct {
	Eext_Floatingbutton_Mode mode;
	Eext_Floatingbutton_Pos pos;
} Eext_Floatingbutton;

static const char *const __posSignals[EEXT_FLOATINGBUTTON_LAST] = {
    "eext,state,pos,left_out", "eext,state,pos,left",      "eext,state,pos,center",
    "eext,state,pos,right",    "eext,state,pos,right_out",
};

static Eext_Floatingbutton *__get(const Evas_Object *obj)
{
	Eext_Floatingbutton *fb = obj ? evas_object_data_get(obj, FB_DATA_KEY) : NULL;
	if (!fb)
		LOGE("%p is not a floating button", (const void *)obj);
	return fb;
}

static Eina_Bool __posAllowed(Eext_Floatingbutton_Mode mode, Eext_Floatingbutton_Pos pos)
{
	if (pos >= EEXT_FLOATINGBUTTON_LAST)
		return EINA_FALSE;
	if (mode == EEXT_FLOATINGBUTTON_MODE_BOTH_SIDES)
		return pos == EEXT_FLOATINGBUTTON_LEFT || pos == EEXT_FLOATINGBUTTON_RIGHT;
	return EINA_TRUE;
}

static void __move(Evas_Object *obj, Eext_Floatingbutton *fb, Eext_Floatingbutton_Pos pos)
{
	fb->pos = pos;
	elm_layout_signal_emit(obj, __posSignals[pos], "eext");
	edje_object_message_signal_process(elm_layout_edje_get(obj));
}

static void __delCb(void *data, Evas *e, Evas_Object *obj, void *event_info)
{
	(void)e;
	(void)obj;
	(void)event_info;
	free(data);
}

/* TIZEN_PLATFORM_DATA_DIR, else the installed tree's folder, else the build's. */
static const char *__dataDir(void)
{
	const char *dir = getenv("TIZEN_PLATFORM_DATA_DIR");
	if (dir && *dir)
		return dir;
	static char *installed;
	if (!installed)
		installed = desktop_app_install_path_get("tizen-platform/data");
	return installed ? installed : TIZEN_PLATFORM_DATA_DIR;
}

Evas_Object *eext_floatingbutton_add(Evas_Object *parent)
{
	if (!parent) {
		LOGE("parent is NULL");
		return NULL;
	}
	Eext_Floatingbutton *fb = calloc(1, sizeof(*fb));
	if (!fb) {
		LOGE("out of memory");
		return NULL;
	}
	Evas_Object *layout = elm_layout_add(parent);
	if (!layout) {
		LOGE("cannot create the layout");
		free(fb);
		return NULL;
	}
	char path[PATH_MAX];
	snprintf(path, sizeof(path), "%s/floatingbutton.edj", __dataDir());
	if (!elm_layout_file_set(layout, path, FB_GROUP))
		LOGE("cannot load %s from %s", FB_GROUP, path);
	fb->mode = EEXT_FLOATINGBUTTON_MODE_DEFAULT;
	evas_object_data_set(layout, FB_DATA_KEY, fb);
	evas_object_event_callback_add(layout, EVAS_CALLBACK_DEL, __delCb, fb);
	__move(layout, fb, EEXT_FLOATINGBUTTON_RIGHT);
	return layout;
}

void eext_floatingbutton_mode_set(Evas_Object *obj, Eext_Floatingbutton_Mode mode)
{
	Eext_Floatingbutton *fb = __get(obj);
	if (!fb)
		return;
	if (mode >= EEXT_FLOATINGBUTTON_MODE_LAST) {
		LOGE("invalid mode %d", (int)mode);
		return;
	}
	fb->mode = mode;
	if (!__posAllowed(mode, fb->pos))
		__move(obj, fb, EEXT_FLOATINGBUTTON_RIGHT);
}

Eext_Floatingbutton_Mode eext_floatingbutton_mode_get(const Evas_Object *obj)
{
	Eext_Floatingbutton *fb = __get(obj);
	return fb ? fb->mode : EEXT_FLOATINGBUTTON_MODE_LAST;
}

Eina_Bool eext_floatingbutton_pos_set(Evas_Object *obj, Eext_Floatingbutton_Pos pos)
{
	Eext_Floatingbutton *fb = __get(obj);
	if (!fb)
		return EINA_FALSE;
	if (!__posAllowed(fb->mode, pos)) {
		LOGE("position %d is not allowed in mode %d", (int)pos, (int)fb->mode);
		return EINA_FALSE;
	}
	__move(obj, fb, pos);
	return EINA_TRUE;
}

Eext_Floatingbutton_Pos eext_floatingbutton_pos_get(const Evas_Object *obj)
{
	Eext_Floatingbutton *fb = __get(obj);
	return fb ? fb->pos : EEXT_FLOATINGBUTTON_LAST;
}
