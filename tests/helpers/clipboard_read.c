/* Prints the text of the clipboard (of the display in DISPLAY) on stdout and ends: status 0, or 1 when
   no text came within three seconds. */
#include <Elementary.h>

#include <stdio.h>

static int status = 1;

static Eina_Bool text_cb(void *data, Evas_Object *obj, Elm_Selection_Data *ev)
{
	(void)data;
	(void)obj;
	fwrite(ev->data, 1, ev->len && ((char *)ev->data)[ev->len - 1] == '\0' ? ev->len - 1 : ev->len, stdout);
	status = 0;
	elm_exit();
	return EINA_TRUE;
}

static Eina_Bool timeout_cb(void *data)
{
	(void)data;
	elm_exit();
	return ECORE_CALLBACK_CANCEL;
}

EAPI_MAIN int elm_main(int argc, char **argv)
{
	(void)argc;
	(void)argv;
	Evas_Object *win = elm_win_add(NULL, "clipboard_read", ELM_WIN_BASIC);
	Evas_Object *label = elm_label_add(win);
	elm_cnp_selection_get(label, ELM_SEL_TYPE_CLIPBOARD, ELM_SEL_FORMAT_TEXT, text_cb, NULL);
	ecore_timer_add(3.0, timeout_cb, NULL);
	elm_run();
	return status;
}
ELM_MAIN()
