// Shared scaffolding of the UI tests.
#include "UiTestSupport.h"

#include <Ecore_Evas.h>

#include <cmath>
#include <cstdint>

#include <WContentViewController.h>
#include <WMenuPopupController.h>
#include <WNaviframeController.h>

#include "TestEnv.h"
#include "Util/MemoUtil.h"

namespace memo_ui_test
{

void initUi()
{
	static const bool ready = [] {
		static char arg0[] = "memo-ui-test";
		static char *argv[] = {arg0, nullptr};
		elm_init(1, argv);
		elm_theme_extension_add(nullptr, MemoUtil::getEdjePath());
		// Long presses in tests should not take a second each.
		elm_config_longpress_timeout_set(0.3);
		return true;
	}();
	(void)ready;
}

void UiFixture::SetUp()
{
	initUi();
	// As the app sets it: layout sizes are given for a scale of 2.6.
	elm_app_base_scale_set(2.6);
	win = elm_win_add(nullptr, "memo-ui-test", ELM_WIN_BASIC);
	ASSERT_NE(win, nullptr);
	elm_win_autodel_set(win, EINA_FALSE);
	Evas_Object *bg = elm_bg_add(win);
	elm_bg_color_set(bg, 250, 248, 242);
	evas_object_size_hint_weight_set(bg, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
	elm_win_resize_object_add(win, bg);
	evas_object_show(bg);

	scroller = elm_scroller_add(win);
	elm_scroller_bounce_set(scroller, EINA_FALSE, EINA_FALSE);
	elm_scroller_policy_set(scroller, ELM_SCROLLER_POLICY_OFF, ELM_SCROLLER_POLICY_AUTO);
	evas_object_size_hint_weight_set(scroller, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
	elm_win_resize_object_add(win, scroller);
	evas_object_show(scroller);

	evas_object_resize(win, 720, 1280);
	evas_object_show(win);
	elm_win_activate(win);
	Ecore_Evas *ee = ecore_evas_ecore_evas_get(evas());
	if (ee)
		ecore_evas_focus_set(ee, EINA_TRUE);
	evas_focus_in(evas());
	desktop_toast_log_clear();
	render();
}

void UiFixture::TearDown()
{
	if (win)
		evas_object_del(win);
	win = scroller = nullptr;
	runFor(0.02);
	elm_config_scale_set(1.0);
}

Evas *UiFixture::evas() const
{
	return evas_object_evas_get(win);
}

void UiFixture::render()
{
	for (int i = 0; i < 3; i++) {
		evas_smart_objects_calculate(evas());
		Ecore_Evas *ee = ecore_evas_ecore_evas_get(evas());
		if (ee)
			ecore_evas_manual_render(ee);
		ecore_main_loop_iterate();
	}
}

namespace
{
struct LoopWait {
	const std::function<bool()> *pred;
	double end;
	bool done;
};

Eina_Bool checkLoopWaitCb(void *data)
{
	LoopWait *wait = static_cast<LoopWait *>(data);
	if ((*wait->pred)() || ecore_time_get() > wait->end) {
		wait->done = true;
		ecore_main_loop_quit();
		return ECORE_CALLBACK_CANCEL;
	}
	return ECORE_CALLBACK_RENEW;
}
} // namespace

bool UiFixture::waitFor(const std::function<bool()> &pred, double timeoutSec)
{
	if (pred())
		return true;
	// A running main loop, unlike single iterations, runs idlers and the ends of worker threads.
	LoopWait wait = {&pred, ecore_time_get() + timeoutSec, false};
	ecore_timer_add(0.005, checkLoopWaitCb, &wait);
	ecore_main_loop_begin();
	return pred();
}

void UiFixture::runFor(double seconds)
{
	const double end = ecore_time_get() + seconds;
	waitFor([end] { return ecore_time_get() > end; }, seconds + 1.0);
}

void UiFixture::pressKey(const char *keyName, const char *string)
{
	evas_event_feed_key_down(evas(), keyName, keyName, string, string, ++__timestamp, nullptr);
	evas_event_feed_key_up(evas(), keyName, keyName, string, string, ++__timestamp, nullptr);
	runFor(0.03);
}

void UiFixture::typeText(const char *text)
{
	for (const char *p = text; *p; p++) {
		const char typed[2] = {*p, '\0'};
		const char *key = *p == ' ' ? "space" : *p == '.' ? "period" : *p == ',' ? "comma" : typed;
		evas_event_feed_key_down(evas(), key, key, typed, typed, ++__timestamp, nullptr);
		evas_event_feed_key_up(evas(), key, key, typed, typed, ++__timestamp, nullptr);
	}
	runFor(0.03);
}

void UiFixture::mouseDown(int x, int y)
{
	evas_event_feed_mouse_move(evas(), x, y, ++__timestamp, nullptr);
	evas_event_feed_mouse_down(evas(), 1, EVAS_BUTTON_NONE, ++__timestamp, nullptr);
	runFor(0.02);
}

void UiFixture::mouseMove(int x, int y)
{
	evas_event_feed_mouse_move(evas(), x, y, ++__timestamp, nullptr);
	runFor(0.02);
}

void UiFixture::mouseUp(int x, int y)
{
	evas_event_feed_mouse_move(evas(), x, y, ++__timestamp, nullptr);
	evas_event_feed_mouse_up(evas(), 1, EVAS_BUTTON_NONE, ++__timestamp, nullptr);
	runFor(0.03);
}

void UiFixture::tap(int x, int y)
{
	mouseDown(x, y);
	mouseUp(x, y);
}

void UiFixture::tapOn(Evas_Object *obj)
{
	int x = 0, y = 0;
	centreOf(obj, &x, &y);
	tap(x, y);
}

void UiFixture::centreOf(Evas_Object *obj, int *x, int *y)
{
	render();
	Evas_Coord ox = 0, oy = 0, ow = 0, oh = 0;
	evas_object_geometry_get(obj, &ox, &oy, &ow, &oh);
	*x = ox + ow / 2;
	*y = oy + oh / 2;
}

static std::vector<Elm_Object_Item *> menuItemsOf(app_assist::WNaviframeController *nav)
{
	app_assist::WViewController *top = nav ? nav->getTopContentViewController() : nullptr;
	app_assist::WViewController *menu = top ? top->getPopup() : nullptr;
	std::vector<Elm_Object_Item *> items;
	if (!dynamic_cast<app_assist::WMenuPopupController *>(menu))
		return items;
	const Eina_List *l = nullptr;
	void *data = nullptr;
	EINA_LIST_FOREACH(elm_list_items_get(elm_object_content_get(menu->getEvasObj())), l, data)
	items.push_back(static_cast<Elm_Object_Item *>(data));
	return items;
}

std::vector<std::string> UiFixture::openMenuOf(app_assist::WNaviframeController *nav)
{
	pressKey("F2");
	runFor(0.3);
	render();
	std::vector<std::string> texts;
	for (Elm_Object_Item *item : menuItemsOf(nav))
		texts.push_back(elm_object_item_text_get(item));
	return texts;
}

void UiFixture::chooseMenuOf(app_assist::WNaviframeController *nav, const std::string &text)
{
	for (Elm_Object_Item *item : menuItemsOf(nav)) {
		if (text == elm_object_item_text_get(item)) {
			tapItem(item);
			runFor(0.3);
			render();
			return;
		}
	}
	FAIL() << "no menu row " << text;
}

void UiFixture::tapItem(Elm_Object_Item *item)
{
	int x = 0, y = 0;
	centreOf(elm_object_item_track(item), &x, &y);
	elm_object_item_untrack(item);
	tap(x, y);
}

void UiFixture::focus(Evas_Object *widget)
{
	evas_focus_in(evas());
	elm_object_focus_set(widget, EINA_TRUE);
	runFor(0.02);
}

bool writePicture(const std::string &path, int w, int h, uint32_t sky, uint32_t hill)
{
	Ecore_Evas *ee = ecore_evas_buffer_new(1, 1);
	Evas_Object *img = ee ? evas_object_image_add(ecore_evas_get(ee)) : nullptr;
	if (!img)
		return false;
	evas_object_image_size_set(img, w, h);
	uint32_t *px = static_cast<uint32_t *>(evas_object_image_data_get(img, EINA_TRUE));
	const int stride = evas_object_image_stride_get(img) / 4;
	for (int y = 0; y < h; y++) {
		for (int x = 0; x < w; x++) {
			const bool ground = y > h * (0.62 + 0.08 * std::sin(x * 5.0 / w));
			const uint32_t shade = ground ? 0 : static_cast<uint32_t>(50 * y / h) * 0x010100;
			px[y * stride + x] = 0xff000000u | ((ground ? hill : sky) + shade);
		}
	}
	evas_object_image_data_set(img, px);
	const Eina_Bool ok = evas_object_image_save(img, path.c_str(), nullptr, "quality=92 compress=1");
	ecore_evas_free(ee);
	return ok;
}

} // namespace memo_ui_test
