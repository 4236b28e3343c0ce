/* Preloaded into a process under measurement: the process ends (_exit 0) as soon as its first window has
   rendered its first frame, so that the time and peak memory of the whole process up to that frame can be
   read from outside. */
#define _GNU_SOURCE
#include <Elementary.h>
#include <dlfcn.h>
#include <unistd.h>

static void render_post_cb(void *data, Evas *e, void *event_info)
{
	(void)data;
	(void)e;
	(void)event_info;
	_exit(0);
}

Evas_Object *elm_win_add(Evas_Object *parent, const char *name, Elm_Win_Type type)
{
	static Evas_Object *(*real)(Evas_Object *, const char *, Elm_Win_Type);
	static int hooked;
	if (!real)
		real = (Evas_Object * (*)(Evas_Object *, const char *, Elm_Win_Type)) dlsym(RTLD_NEXT, "elm_win_add");
	Evas_Object *win = real ? real(parent, name, type) : NULL;
	if (win && !hooked) {
		hooked = 1;
		evas_event_callback_add(evas_object_evas_get(win), EVAS_CALLBACK_RENDER_POST, render_post_cb, NULL);
	}
	return win;
}
