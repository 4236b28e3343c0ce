#ifndef TESTS_UI_SUPPORT_MEMOLISTFIXTURE_H
#define TESTS_UI_SUPPORT_MEMOLISTFIXTURE_H

// Scaffolding of the memo list tests: a fresh store with memos written as the editor saves them, a grid on
// the test window, and the real application (MemoApp without its platform loop) showing its first screen.

#include <string>
#include <vector>

#include "List/MemoGridControl.h"
#include "MemoApp.h"
#include "UiTestSupport.h"

namespace app_assist
{
class WNaviframeController;
}
class MemoListView;

namespace memo_ui_test
{

// A memo as it is written to the store: TestMemo("title", "display").voice("vr-1").favourite().
struct TestMemo {
	explicit TestMemo(std::string memoTitle = "", std::string memoDisplay = "")
	    : title(std::move(memoTitle)), display(std::move(memoDisplay))
	{
	}
	TestMemo &voice(const std::string &uuid) { return set(voiceUuid, uuid); }
	TestMemo &picture(const std::string &path) { return set(thumbnail, path); }
	TestMemo &color(const std::string &text) { return set(bgColor, text); }
	TestMemo &favourite()
	{
		isFavourite = 1;
		return *this;
	}
	TestMemo &hidden()
	{
		isHidden = 1;
		return *this;
	}

	std::string title;
	std::string display;  // display_Content, with "<CHECK state=...>" markers
	std::string tizenXml; // a non-empty display gets a stand-in document when this stays empty
	std::string voiceUuid;
	std::string thumbnail;
	std::string bgColor;
	int isFavourite = 0;
	int isHidden = 0;

private:
	TestMemo &set(std::string &field, const std::string &value)
	{
		field = value;
		return *this;
	}
};

// Display text of check lines: '+' ticked, '-' unticked, anything else a plain line, then the text.
std::string checkLines(const std::vector<std::string> &lines);

// Store helpers: every test starts from no database, no media and the feature keys unset.
void resetStore();
std::string addMemo(const TestMemo &memo);
std::string dataPath();

class GridFixture : public UiFixture
{
protected:
	void SetUp() override;
	void TearDown() override;

	// Resizes the window once the canvas has finished drawing: the buffer engine's render thread must not
	// draw into a buffer that the resize replaces.
	void resizeWindow(int w, int h);
	// A grid of the given mode (null: the main list) filling the window, updated once.
	MemoGridControl *makeGrid(int *mode = nullptr);
	// The card at index after a render, null past the end.
	Elm_Object_Item *cardAt(int index);
	// A text and a content of a realized card.
	std::string cardText(Elm_Object_Item *card, const char *part);
	Evas_Object *cardContent(Elm_Object_Item *card, const char *part);
	// The text of a part of a layout the card swallowed, "" when absent.
	static std::string layoutText(Evas_Object *layout, const char *part);

	MemoGridControl *grid = nullptr;
};

// MemoApp created as the platform does (onCreate, then the first request) on the buffer engine; `win` is its
// window, so the event helpers of UiFixture reach it.
class ListViewFixture : public UiFixture
{
protected:
	void SetUp() override;
	void TearDown() override;

	// Starts the app with the operation (null: a plain start) on the store as it is.
	void startApp(const char *operation = nullptr);
	app_assist::WNaviframeController *naviframe();
	MemoListView *listView();
	// The grid's gengrid on the list, null with the empty state.
	Evas_Object *gengrid();
	// The floating button's button while it is shown in the window, else null.
	Evas_Object *floatingButton();
	// Taps the centre of the card at index (scrolled into view first).
	void tapCard(int index);
	// The log lines written since the app started.
	std::string logSince();

	MemoApp *app = nullptr;

private:
	size_t __logStart = 0;
};

} // namespace memo_ui_test

#endif
