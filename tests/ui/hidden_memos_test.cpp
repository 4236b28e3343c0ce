// Hidden memos as a person meets them (the app on the buffer engine, raw key events for the PIN): the ways in
// from the list, creating the PIN in two passes, entering it, changing it, the lock-out after wrong PINs, the
// reset through the account confirmation (the real companion, another process), and the hidden memos' page.
#include <app_manager.h>

#include "support/HiddenMemosFixture.h"

#include "DataBase/MemoDocInfo.h"
#include "View/MemoEditView.h"
#include "View/MemoHiddenFirstAccess.h"
#include "View/MemoHiddenView.h"
#include "View/MemoListView.h"
#include "View/MemoSearchView.h"
#include "View/MemoSelectionView.h"
#include "View/MemoSettingsView.h"

using namespace memo_ui_test;

namespace
{
class HiddenMemosTest : public HiddenMemosFixture
{
protected:
	Elm_Object_Item *settingsRow()
	{
		Evas_Object *list = elm_object_part_content_get(top<MemoSettingsView>()->getEvasObj(), "contents");
		return elm_genlist_first_item_get(list);
	}
	// What the row shows, as the list asks its item class for it.
	std::string settingsRowText()
	{
		Elm_Object_Item *row = settingsRow();
		char *text = elm_genlist_item_item_class_get(row)->func.text_get(elm_object_item_data_get(row),
		                                                                 elm_object_item_widget_get(row), "elm.text");
		std::string result = text ? text : "";
		free(text);
		return result;
	}
};

TEST_F(HiddenMemosTest, createThePinInTwoPassesFromTheListThenTheChoiceOfHiddenMemos)
{
	startApp();
	std::vector<std::string> rows = openMenu();
	ASSERT_GE(rows.size(), 2u);
	EXPECT_EQ("Hidden memos", rows[rows.size() - 2]);
	EXPECT_EQ("Settings", rows.back());

	// The settings' row in two levels: without a PIN it offers to set one; back returns, a second back leaves.
	chooseMenu("Settings");
	ASSERT_NE(nullptr, waitTop<MemoSettingsView>());
	EXPECT_EQ("Hidden mode", settingsRowText());
	tapItem(settingsRow());
	runFor(0.2);
	EXPECT_EQ("Set PIN", settingsRowText());
	pressKey("Escape");
	EXPECT_EQ("Hidden mode", settingsRowText());
	pressKey("Escape");
	ASSERT_NE(nullptr, waitTop<MemoListView>());

	openMenu();
	chooseMenu("Hidden memos");
	MemoHiddenFirstAccess *firstAccess = waitTop<MemoHiddenFirstAccess>();
	ASSERT_NE(nullptr, firstAccess);
	EXPECT_EQ(nullptr, floatingButton());
	tapOn(elm_object_part_content_get(firstAccess->getEvasObj(), "start_button"));
	ASSERT_NE(nullptr, waitTop<MemoHiddenPasswordView>());
	EXPECT_EQ("Create PIN", barText());

	// BackSpace at the first entry, Return, the back and more keys change nothing; BackSpace later takes one back.
	for (const char *key : {"BackSpace", "Return", "XF86Back", "1", "Escape", "9", "BackSpace", "F2"})
		pinKey(key);
	EXPECT_EQ("* | | | ", entryTexts());
	typePin("234");
	EXPECT_EQ("Confirm PIN", barText());
	EXPECT_EQ(" | | | ", entryTexts());

	// A different confirmation keeps the first PIN, and the next try may match it.
	typePin("1243");
	EXPECT_EQ("Incorrect PIN entered", barText());
	EXPECT_EQ("", storedPin());
	typePin("1234");
	EXPECT_EQ(digestOf("1234"), storedPin());
	// No memo is hidden yet: the choice of hidden memos follows.
	EXPECT_NE(nullptr, waitTop<MemoSelectionView>());
}

TEST_F(HiddenMemosTest, wrongAndRightPinsTheForgottenPinButtonWithAnAccountAndAChangeOfPin)
{
	addMemo(TestMemo("Secret", "hidden text").hidden());
	storePin("1234");
	startApp();
	openMenu();
	chooseMenu("Hidden memos");
	ASSERT_NE(nullptr, waitTop<MemoHiddenPasswordView>());
	EXPECT_EQ("Enter PIN", barText());

	typePin("1111");
	EXPECT_EQ("Incorrect PIN entered", barText());
	EXPECT_FALSE(forgottenPinShown());
	signIn();
	typePin("1112");
	EXPECT_TRUE(forgottenPinShown());

	typePin("1234");
	MemoHiddenView *hidden = waitTop<MemoHiddenView>();
	ASSERT_NE(nullptr, hidden);
	EXPECT_EQ(0, MemoHiddenPinLock::getWrongCount());
	EXPECT_EQ((std::vector<std::string>{"Edit Hidden Memo", "Delete", "Search", "Change PIN"}), openMenu());
	chooseMenu("Search");
	MemoSearchView *search = waitTop<MemoSearchView>();
	ASSERT_NE(nullptr, search);
	EXPECT_EQ(5, search->gridMode);
	pressKey("Escape");
	ASSERT_EQ(hidden, waitTop<MemoHiddenView>());
	openMenu();

	// The change: the old PIN, then a new one twice; any key counts by the first letter of its name.
	chooseMenu("Change PIN");
	ASSERT_NE(nullptr, waitTop<MemoHiddenPasswordView>());
	typePin("1234");
	EXPECT_EQ("Create PIN", barText());
	typePin("abcd");
	EXPECT_EQ("Confirm PIN", barText());
	typePin("abcd");
	EXPECT_EQ(digestOf("abcd"), storedPin());
	EXPECT_NE(nullptr, waitTop<MemoHiddenView>());
}

TEST_F(HiddenMemosTest, fiveWrongPinsLockTheTriesAcrossARestartAndEachFurtherOneDoublesTheWait)
{
	double now = 1.7e9;
	MemoHiddenPinLock::setClock([&now] { return now; });
	addMemo(TestMemo("Secret", "hidden text").hidden());
	storePin("1234");
	startApp();
	naviframe()->push(new MemoHiddenPasswordView(listView()));
	ASSERT_NE(nullptr, waitTop<MemoHiddenPasswordView>());
	for (int i = 0; i < 4; i++)
		typePin("0000");
	EXPECT_EQ("Incorrect PIN entered", barText());
	typePin("0000");
	EXPECT_EQ("Try again in 30 seconds", barText());
	// Refused while locked, the right PIN too.
	typePin("1234");
	EXPECT_EQ(" | | | ", entryTexts());
	EXPECT_NE(nullptr, top<MemoHiddenPasswordView>());

	restartApp();
	naviframe()->push(new MemoHiddenPasswordView(listView()));
	ASSERT_NE(nullptr, waitTop<MemoHiddenPasswordView>());
	EXPECT_EQ("Try again in 30 seconds", barText());
	now += 31;
	typePin("0000");
	EXPECT_EQ("Try again in 60 seconds", barText());
	now += 61;
	typePin("1234");
	EXPECT_NE(nullptr, waitTop<MemoHiddenView>());
	EXPECT_EQ(0, MemoHiddenPinLock::getWrongCount());
	EXPECT_EQ(0, MemoHiddenPinLock::getRemainingSeconds());
}

TEST_F(HiddenMemosTest, onlyAConfirmedAccountLetsANewPinBeMade)
{
	addMemo(TestMemo("Secret", "hidden text").hidden());
	storePin("1234");
	signIn();
	setenv("VELTRON_ACCOUNT_TEST_PASSWORD", "s3cret", 1);
	startApp();
	naviframe()->push(new MemoHiddenPasswordView(listView()));
	ASSERT_NE(nullptr, waitTop<MemoHiddenPasswordView>());
	typePin("0000");
	ASSERT_TRUE(forgottenPinShown());

	// The companion answers as its window is used: Cancel, a wrong password, the right one.
	const std::vector<std::pair<std::string, std::string>> uses = {{"Cancel", ""}, {"OK", "wrong"}, {"OK", "s3cret"}};
	const char *const logged[] = {"ended with result", "failed: Authentication failure", "account confirmed"};
	for (size_t i = 0; i < uses.size(); i++) {
		setenv("COMPANION_TEST_CLICK", uses[i].first.c_str(), 1);
		setenv("COMPANION_TEST_TYPE", uses[i].second.c_str(), 1);
		tapOn(elm_object_part_content_get(pinLayout(), "bottom"));
		EXPECT_TRUE(waitFor([&] { return logSince().find(logged[i]) != std::string::npos; }, 20.0)) << logged[i];
		EXPECT_TRUE(waitFor(
		    [] {
			    bool running = true;
			    app_manager_is_running("com.veltron.veltronaccount", &running);
			    return !running;
		    },
		    10.0));
		runFor(0.6);
		if (i < 2) {
			EXPECT_EQ(digestOf("1234"), storedPin());
			EXPECT_EQ("Incorrect PIN entered", barText());
		}
	}
	unsetenv("COMPANION_TEST_CLICK");
	unsetenv("COMPANION_TEST_TYPE");
	unsetenv("VELTRON_ACCOUNT_TEST_PASSWORD");
	EXPECT_EQ("Create PIN", barText());
	EXPECT_FALSE(forgottenPinShown());
	typePin("5678");
	typePin("5678");
	EXPECT_EQ(digestOf("5678"), storedPin());
	EXPECT_NE(nullptr, waitTop<MemoHiddenView>());
}

TEST_F(HiddenMemosTest, anEmptyHiddenPageOffersThePinChangeAndItsNewMemoStaysInTheList)
{
	vconf_set_int("db/desktop/csc/feature_92", 0);
	storePin("1234");
	startApp();
	naviframe()->push(new MemoHiddenView(listView()));
	MemoHiddenView *hidden = waitTop<MemoHiddenView>();
	ASSERT_NE(nullptr, hidden);
	EXPECT_EQ((std::vector<std::string>{"Change PIN"}), openMenu());
	pressKey("Escape");
	runFor(0.3);

	// A memo written from the page's floating button is not hidden: the list shows it.
	ASSERT_NE(nullptr, floatingButton());
	tapOn(floatingButton());
	MemoEditView *editor = waitTop<MemoEditView>();
	ASSERT_NE(nullptr, editor);
	Evas_Object *box = elm_object_content_get(elm_object_part_content_get(editor->getEvasObj(), "edit_view_contents"));
	Eina_List *items = elm_box_children_get(box);
	Evas_Object *body = elm_object_part_content_get(
	    elm_object_part_content_get(static_cast<Evas_Object *>(eina_list_nth(items, 1)), "content"), "entry");
	eina_list_free(items);
	tapOn(body);
	typeText("Groceries");
	tapOn(elm_object_item_part_content_get(editor->getNaviItem(), "title_right_btn"));
	ASSERT_EQ(hidden, waitTop<MemoHiddenView>());
	pressKey("Escape");
	ASSERT_NE(nullptr, waitTop<MemoListView>());
	EXPECT_EQ(1, listView()->getGridItemCount());
}
} // namespace
