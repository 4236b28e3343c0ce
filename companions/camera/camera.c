/* The camera: takes one picture at the asked resolution ("RESOLUTION" of the request) and answers
   with its path in /appcontrol/data/selected; with no camera it says so and answers "failed". */
#define _GNU_SOURCE
#include "camera_shot.h"
#include "companion.h"

#include <app.h>
#include <dlog.h>
#include <gst/gst.h>
#include <stdio.h>
#include <stdlib.h>
#include <string.h>
#include <time.h>

#define DEFAULT_WIDTH 1280
#define DEFAULT_HEIGHT 720
/* How long the picture stays on screen before the camera ends. */
#define SHOWN_SEC 1.0

static struct {
	Evas_Object *status;
	Evas_Object *picture;
	Evas_Object *close;
	Ecore_Thread *thread;
	Ecore_Timer *exit_timer;
} ui;

static void close_clicked_cb(void *data, Evas_Object *obj, void *event_info)
{
	(void)data;
	(void)obj;
	(void)event_info;
	ui_app_exit();
}

static Eina_Bool exit_cb(void *data)
{
	(void)data;
	ui.exit_timer = NULL;
	ui_app_exit();
	return ECORE_CALLBACK_CANCEL;
}

static void show_failure(const char *message)
{
	LOGE("%s", message);
	elm_object_text_set(ui.status, message);
	evas_object_show(ui.close);
	companion_request_answer(APP_CONTROL_RESULT_FAILED, NULL);
}

/* "<Pictures>/Camera/IMG_<date>_<time>[_<n>].jpg" (malloc'ed); NULL when the folder cannot be made. */
static char *picture_path_new(void)
{
	char *pictures = companion_user_dir_get("PICTURES", "Pictures", true);
	char *dir = NULL;
	if (asprintf(&dir, "%s/Camera", pictures) < 0)
		dir = NULL;
	free(pictures);
	if (!dir || !ecore_file_mkpath(dir)) {
		free(dir);
		return NULL;
	}
	char stamp[32];
	time_t now = time(NULL);
	strftime(stamp, sizeof(stamp), "%Y%m%d_%H%M%S", localtime(&now));
	char *path = NULL;
	for (int n = 0; n < 100; n++) {
		free(path);
		int len = n ? asprintf(&path, "%s/IMG_%s_%d.jpg", dir, stamp, n) : asprintf(&path, "%s/IMG_%s.jpg", dir, stamp);
		if (len < 0) {
			path = NULL;
			break;
		}
		if (!ecore_file_exists(path))
			break;
	}
	free(dir);
	return path;
}

static void shot_free(camera_shot_s *shot)
{
	free(shot->device);
	free(shot->path);
	free(shot->error);
	free(shot);
}

static void shot_run_cb(void *data, Ecore_Thread *thread)
{
	(void)thread;
	camera_shot_take(data);
}

static void shot_end_cb(void *data, Ecore_Thread *thread)
{
	(void)thread;
	camera_shot_s *shot = data;
	ui.thread = NULL;
	if (shot->error) {
		show_failure(shot->error);
		shot_free(shot);
		return;
	}
	LOGI("picture %dx%d taken: %s", shot->width, shot->height, shot->path);
	elm_object_text_set(ui.status, "Picture taken.");
	elm_image_file_set(ui.picture, shot->path, NULL);
	evas_object_show(ui.picture);
	const char *paths[] = {shot->path};
	app_control_h reply = NULL;
	app_control_create(&reply);
	app_control_add_extra_data_array(reply, COMPANION_KEY_SELECTED, paths, 1);
	app_control_add_extra_data_array(reply, COMPANION_KEY_PATH, paths, 1);
	companion_request_answer(APP_CONTROL_RESULT_SUCCEEDED, reply);
	app_control_destroy(reply);
	shot_free(shot);
	ui.exit_timer = ecore_timer_add(SHOWN_SEC, exit_cb, NULL);
}

static void shot_cancel_cb(void *data, Ecore_Thread *thread)
{
	(void)thread;
	shot_free(data);
}

static void request(app_control_h request)
{
	/* The picture under way answers the newest request. */
	if (ui.thread)
		return;
	camera_shot_s *shot = calloc(1, sizeof(*shot));
	if (!shot)
		return;
	char *resolution = companion_extra_get(request, "RESOLUTION");
	if (!camera_shot_resolution_parse(resolution, &shot->width, &shot->height)) {
		shot->width = DEFAULT_WIDTH;
		shot->height = DEFAULT_HEIGHT;
	}
	free(resolution);
	const char *test = getenv(CAMERA_TEST_SOURCE_ENV);
	bool test_source = test && !strcmp(test, "1");
	if (!test_source && !(shot->device = camera_shot_device_find())) {
		shot_free(shot);
		show_failure("No camera was found. Connect a camera and try again.");
		return;
	}
	if (!(shot->path = picture_path_new())) {
		shot_free(shot);
		show_failure("The Pictures folder cannot be written.");
		return;
	}
	evas_object_hide(ui.close);
	evas_object_hide(ui.picture);
	elm_object_text_set(ui.status, "Taking a picture…");
	ui.thread = ecore_thread_run(shot_run_cb, shot_end_cb, shot_cancel_cb, shot);
}

static bool create(Evas_Object *win, Evas_Object *box)
{
	gst_init(NULL, NULL);
	ui.status = companion_label_add(box, "");
	ui.picture = elm_image_add(box);
	evas_object_size_hint_weight_set(ui.picture, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
	evas_object_size_hint_align_set(ui.picture, EVAS_HINT_FILL, EVAS_HINT_FILL);
	elm_box_pack_end(box, ui.picture);
	ui.close = companion_button_add(box, "Close", close_clicked_cb, NULL);
	evas_object_hide(ui.close);
	evas_object_resize(win, ELM_SCALE_SIZE(480), ELM_SCALE_SIZE(400));
	return true;
}

static void terminate(void)
{
	if (ui.thread)
		ecore_thread_cancel(ui.thread);
	if (ui.exit_timer)
		ecore_timer_del(ui.exit_timer);
	ui.exit_timer = NULL;
}

int main(int argc, char **argv)
{
	static const companion_app_s app = {
	    .name = "camera", .title = "Camera", .create = create, .request = request, .terminate = terminate};
	return companion_main(argc, argv, &app);
}
