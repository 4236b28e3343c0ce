/* com.veltron.memo-popup: asks whether the recording that the notification panel's memo controller wants
   to cancel may really be thrown away. "Discard" answers succeeded (the app cancels the recording), "Keep
   recording" answers failed (the app shows its controller again); closing the window answers canceled. The
   app ends after each answer. */
#include "companion.h"

#include <app.h>
#include <dlog.h>

static void answer(app_control_result_e result)
{
	if (!companion_request_answer(result, NULL))
		LOGE("no request to answer");
	ui_app_exit();
}

static void discard_clicked_cb(void *data, Evas_Object *obj, void *event_info)
{
	(void)data;
	(void)obj;
	(void)event_info;
	answer(APP_CONTROL_RESULT_SUCCEEDED);
}

static void keep_clicked_cb(void *data, Evas_Object *obj, void *event_info)
{
	(void)data;
	(void)obj;
	(void)event_info;
	answer(APP_CONTROL_RESULT_FAILED);
}

static bool create(Evas_Object *win, Evas_Object *box)
{
	companion_label_add(box, "<b>Discard recording?</b><br>"
	                         "The recording will be stopped and the file will be discarded.");
	Evas_Object *row = elm_box_add(box);
	elm_box_horizontal_set(row, EINA_TRUE);
	elm_box_homogeneous_set(row, EINA_TRUE);
	elm_box_padding_set(row, ELM_SCALE_SIZE(8), 0);
	evas_object_size_hint_weight_set(row, EVAS_HINT_EXPAND, 0.0);
	evas_object_size_hint_align_set(row, EVAS_HINT_FILL, 0.5);
	elm_box_pack_end(box, row);
	evas_object_show(row);
	companion_button_add(row, "Keep recording", keep_clicked_cb, NULL);
	companion_button_add(row, "Discard", discard_clicked_cb, NULL);
	elm_win_center(win, EINA_TRUE, EINA_TRUE);
	evas_object_resize(win, ELM_SCALE_SIZE(420), ELM_SCALE_SIZE(160));
	return true;
}

static void request(app_control_h request)
{
	(void)request;
	Evas_Object *win = companion_window_get();
	elm_win_raise(win);
	elm_win_activate(win);
}

int main(int argc, char **argv)
{
	static const companion_app_s app = {
	    .name = "memo-popup", .title = "Memo", .create = create, .request = request, .terminate = NULL};
	return companion_main(argc, argv, &app);
}
