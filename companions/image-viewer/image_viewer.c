/* com.veltron.image-viewer: shows the picture of the request's uri fitted to the window and zoomable
   (buttons, Control with the mouse wheel, pinching). With "DeleteMenu" = "TRUE" it offers Delete, which
   answers with "DeleteMenu" = "TRUE"; the caller removes the picture. */
#include "companion.h"

#include <app.h>
#include <dlog.h>
#include <stdlib.h>
#include <string.h>

#define DELETE_MENU_KEY "DeleteMenu"
#define ZOOM_STEP 1.25
/* Photocam zoom: 1 shows one picture pixel per screen pixel, larger values shrink it. */
#define ZOOM_CLOSEST 0.125
#define ZOOM_FARTHEST 32.0

static struct {
	Evas_Object *photo;
	Evas_Object *message;
	Evas_Object *delete_button;
} ui;

/* factor > 1 zooms in, < 1 out, 0 fits the picture to the window again. */
static void zoom(double factor)
{
	if (factor == 0.0) {
		elm_photocam_zoom_mode_set(ui.photo, ELM_PHOTOCAM_ZOOM_MODE_AUTO_FIT);
		return;
	}
	double z = elm_photocam_zoom_get(ui.photo) / factor;
	elm_photocam_zoom_mode_set(ui.photo, ELM_PHOTOCAM_ZOOM_MODE_MANUAL);
	elm_photocam_zoom_set(ui.photo, z < ZOOM_CLOSEST ? ZOOM_CLOSEST : z > ZOOM_FARTHEST ? ZOOM_FARTHEST : z);
}

static void zoom_in_cb(void *data, Evas_Object *obj, void *event_info)
{
	(void)data;
	(void)obj;
	(void)event_info;
	zoom(ZOOM_STEP);
}

static void zoom_out_cb(void *data, Evas_Object *obj, void *event_info)
{
	(void)data;
	(void)obj;
	(void)event_info;
	zoom(1.0 / ZOOM_STEP);
}

static void fit_cb(void *data, Evas_Object *obj, void *event_info)
{
	(void)data;
	(void)obj;
	(void)event_info;
	zoom(0.0);
}

static void wheel_cb(void *data, Evas *e, Evas_Object *obj, void *event_info)
{
	(void)data;
	(void)e;
	(void)obj;
	Evas_Event_Mouse_Wheel *ev = event_info;
	if (!evas_key_modifier_is_set(ev->modifiers, "Control"))
		return;
	zoom(ev->z < 0 ? ZOOM_STEP : 1.0 / ZOOM_STEP);
	ev->event_flags |= EVAS_EVENT_FLAG_ON_HOLD;
}

static void delete_cb(void *data, Evas_Object *obj, void *event_info)
{
	(void)data;
	(void)obj;
	(void)event_info;
	app_control_h reply = NULL;
	app_control_create(&reply);
	app_control_add_extra_data(reply, DELETE_MENU_KEY, "TRUE");
	LOGI("delete asked for");
	companion_request_answer(APP_CONTROL_RESULT_SUCCEEDED, reply);
	app_control_destroy(reply);
	ui_app_exit();
}

static void request(app_control_h request)
{
	char *uri = NULL;
	app_control_get_uri(request, &uri);
	char *path = companion_path_from_uri(uri);
	free(uri);
	Evas_Load_Error err = path ? elm_photocam_file_set(ui.photo, path) : EVAS_LOAD_ERROR_DOES_NOT_EXIST;
	if (err != EVAS_LOAD_ERROR_NONE) {
		LOGE("cannot show %s: %s", path ? path : "(no file uri)", evas_load_error_str(err));
		elm_object_text_set(ui.message, "This picture cannot be shown.");
		evas_object_show(ui.message);
		evas_object_hide(ui.photo);
	} else {
		evas_object_hide(ui.message);
		evas_object_show(ui.photo);
		zoom(0.0);
		elm_win_title_set(companion_window_get(), ecore_file_file_get(path));
	}
	free(path);
	char *menu = companion_extra_get(request, DELETE_MENU_KEY);
	elm_object_disabled_set(ui.delete_button, err != EVAS_LOAD_ERROR_NONE);
	if (menu && !strcmp(menu, "TRUE"))
		evas_object_show(ui.delete_button);
	else
		evas_object_hide(ui.delete_button);
	free(menu);
}

static bool create(Evas_Object *win, Evas_Object *box)
{
	ui.message = companion_label_add(box, "");
	evas_object_hide(ui.message);
	ui.photo = elm_photocam_add(box);
	elm_photocam_gesture_enabled_set(ui.photo, EINA_TRUE);
	elm_photocam_paused_set(ui.photo, EINA_TRUE); /* no zoom animation: buttons act at once */
	evas_object_size_hint_weight_set(ui.photo, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
	evas_object_size_hint_align_set(ui.photo, EVAS_HINT_FILL, EVAS_HINT_FILL);
	evas_object_event_callback_add(ui.photo, EVAS_CALLBACK_MOUSE_WHEEL, wheel_cb, NULL);
	elm_box_pack_end(box, ui.photo);
	evas_object_show(ui.photo);

	Evas_Object *bar = elm_box_add(box);
	elm_box_horizontal_set(bar, EINA_TRUE);
	elm_box_homogeneous_set(bar, EINA_TRUE);
	evas_object_size_hint_align_set(bar, EVAS_HINT_FILL, 1.0);
	companion_button_add(bar, "Fit", fit_cb, NULL);
	companion_button_add(bar, "Zoom out", zoom_out_cb, NULL);
	companion_button_add(bar, "Zoom in", zoom_in_cb, NULL);
	ui.delete_button = companion_button_add(bar, "Delete", delete_cb, NULL);
	evas_object_hide(ui.delete_button);
	elm_box_pack_end(box, bar);
	evas_object_show(bar);
	evas_object_resize(win, ELM_SCALE_SIZE(640), ELM_SCALE_SIZE(520));
	return true;
}

int main(int argc, char **argv)
{
	static const companion_app_s app = {
	    .name = "image-viewer", .title = "Image viewer", .create = create, .request = request};
	return companion_main(argc, argv, &app);
}
