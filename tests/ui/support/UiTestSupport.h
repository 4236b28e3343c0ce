#ifndef TESTS_UI_SUPPORT_UITESTSUPPORT_H
#define TESTS_UI_SUPPORT_UITESTSUPPORT_H

// Scaffolding of the in-process UI tests: Elementary on the buffer engine with the app's theme, a
// window holding a scroller, and real key and pointer events fed to its canvas.

#include <cstdint>
#include <functional>
#include <string>
#include <vector>

#include <Elementary.h>
// The toasts posted: desktop_toast_log_count(), _get(index) and _clear().
#include <desktop/toast_log.h>
#include <gtest/gtest.h>

namespace app_assist
{
class WNaviframeController;
}

namespace memo_ui_test
{

// Elementary and the app's theme, once per process. Safe to call again.
void initUi();

// A window of 720 x 1280 with a background and a scroller, at the app's scale; tests may change the
// scale.
class UiFixture : public ::testing::Test
{
protected:
	void SetUp() override;
	void TearDown() override;

	Evas *evas() const;

	// Lets the canvas compute its layout (smart calculation and a render), so geometries are real.
	void render();
	// Runs the main loop, idlers, timers and thread ends included, until pred() holds or timeoutSec
	// passes; returns pred().
	bool waitFor(const std::function<bool()> &pred, double timeoutSec = 3.0);
	// Runs the main loop for the given time.
	void runFor(double seconds);

	// One key press and release (`string` is what the key types, null for none), then the handlers run.
	void pressKey(const char *keyName, const char *string = nullptr);
	// Types ASCII text, one key press per character.
	void typeText(const char *text);

	// Pointer events at canvas coordinates; each lets the handlers run.
	void mouseDown(int x, int y);
	void mouseMove(int x, int y);
	void mouseUp(int x, int y);
	// Down and up at one point, or at the centre of an object.
	void tap(int x, int y);
	void tapOn(Evas_Object *obj);
	// The centre of an object's geometry, after a render.
	void centreOf(Evas_Object *obj, int *x, int *y);

	// Focuses the widget and gives the canvas the keyboard.
	void focus(Evas_Object *widget);

	// The more menu of the page on top of `nav`: opened by its key (the texts of its rows; empty when no
	// menu opened), and a tap on the row that reads `text`.
	std::vector<std::string> openMenuOf(app_assist::WNaviframeController *nav);
	void chooseMenuOf(app_assist::WNaviframeController *nav, const std::string &text);
	// Taps a widget item where it shows (the item may go with the tap).
	void tapItem(Elm_Object_Item *item);

	Evas_Object *win = nullptr;
	Evas_Object *scroller = nullptr;

private:
	unsigned int __timestamp = 1000;
};

// Writes a picture of w x h to `path` in the format of its extension (.jpg, .png) through a throw-away
// buffer canvas: a small landscape, sky over a hill, so that screenshots show a picture and not a test
// card. False when Evas cannot save it.
bool writePicture(const std::string &path, int w, int h, uint32_t sky = 0x7fb6e0, uint32_t hill = 0x3f7a4a);

} // namespace memo_ui_test

#endif
