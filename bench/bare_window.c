/* The reference of the cold start: a bare Elementary window with a naviframe holding one empty page, the
   least an app on this toolkit shows. Ends on its first rendered frame when run under first_frame_exit. */
#include <Elementary.h>

int main(int argc, char **argv)
{
	elm_init(argc, argv);
	Evas_Object *win = elm_win_add(NULL, "bare", ELM_WIN_BASIC);
	elm_win_autodel_set(win, EINA_TRUE);
	Evas_Object *naviframe = elm_naviframe_add(win);
	evas_object_size_hint_weight_set(naviframe, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
	elm_win_resize_object_add(win, naviframe);
	evas_object_show(naviframe);
	Evas_Object *page = elm_bg_add(naviframe);
	elm_naviframe_item_push(naviframe, "Page", NULL, NULL, page, NULL);
	evas_object_resize(win, 480, 800);
	evas_object_show(win);
	elm_run();
	elm_shutdown();
	return 0;
}
