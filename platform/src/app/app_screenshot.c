/* On the buffer engine (in-process tests): save the first screen of the app as PNG (TIZEN_SCREENSHOT=<png>). */
#include <Ecore_Evas.h>
#include <Elementary.h>
#include <app.h>

#include "app_private.h"

#include <dlog.h>
#include <stdlib.h>
#include <string.h>

/* Time for the first view to be laid out and rendered after its request. */
#define SCREENSHOT_DELAY_SEC 1.0

static Ecore_Timer *timer;

static bool canvas_save(Evas_Object *win, const char *png)
{
	Evas *evas = evas_object_evas_get(win);
	Ecore_Evas *ee = evas ? ecore_evas_ecore_evas_get(evas) : NULL;
	if (!ee)
		return false;
	ecore_evas_manual_render(ee);
	int w = 0, h = 0;
	ecore_evas_geometry_get(ee, NULL, NULL, &w, &h);
	const void *pixels = ecore_evas_buffer_pixels_get(ee);
	if (!pixels || w <= 0 || h <= 0) {
		LOGE("no pixels to save: screenshots need the buffer engine (ELM_ENGINE=buffer)");
		return false;
	}
	/* Copied into an image object so that Evas' own PNG saver writes it. */
	Evas_Object *img = evas_object_image_add(evas);
	evas_object_image_colorspace_set(img, EVAS_COLORSPACE_ARGB8888);
	evas_object_image_alpha_set(img, EINA_FALSE);
	evas_object_image_size_set(img, w, h);
	evas_object_image_data_copy_set(img, (void *)pixels);
	Eina_Bool ok = evas_object_image_save(img, png, NULL, "compress=6");
	evas_object_del(img);
	return ok;
}

static Eina_Bool screenshot_cb(void *data)
{
	(void)data;
	timer = NULL;
	const char *png = getenv("TIZEN_SCREENSHOT");
	Evas_Object *win = app_window_main_get();
	if (!png || !win)
		LOGE("no window to take a screenshot of");
	else if (canvas_save(win, png))
		LOGI("screenshot saved to %s", png);
	else
		LOGE("cannot save the screenshot to %s", png);
	const char *quit = getenv("TIZEN_SCREENSHOT_EXIT");
	if (quit && !strcmp(quit, "1"))
		ui_app_exit();
	return ECORE_CALLBACK_CANCEL;
}

void app_screenshot_schedule(void)
{
	const char *png = getenv("TIZEN_SCREENSHOT");
	if (!png || !*png || timer)
		return;
	timer = ecore_timer_add(SCREENSHOT_DELAY_SEC, screenshot_cb, NULL);
}

void app_screenshot_cancel(void)
{
	if (timer)
		ecore_timer_del(timer);
	timer = NULL;
}
