#ifndef TESTS_UI_SUPPORT_EDITVIEWFIXTURE_H
#define TESTS_UI_SUPPORT_EDITVIEWFIXTURE_H

// The real app (MemoApp::onCreate on a fresh memo.db) with edit views pushed on its naviframe, driven by key
// and pointer events fed to its window.

#include <Ecore_File.h>
#include <app_preference.h>
#include <clocale>
#include <sqlite3.h>
#include <unistd.h>
#include <vconf.h>

#include <memory>
#include <string>
#include <vector>

#include <WNaviframeController.h>
#include <WWindowController.h>

#include "DataBase/MemoDbMgr.h"
#include "DataBase/MemoDocInfo.h"
#include "MemoApp.h"
#include "Model/MemoBroadCaster.h"
#include "Model/MemoPopupMonitor.h"
#include "Util/MemoUtil.h"
#include "View/MemoEditView.h"
#include "UiTestSupport.h"

namespace memo_ui_test
{

class EditViewFixture : public UiFixture
{
protected:
	void SetUp() override
	{
		initUi();
		// English texts, as the app shows them: plain "C" would leave the message ids on the buttons.
		setenv("LANGUAGE", "en", 1);
		setlocale(LC_ALL, "C.UTF-8");
		const std::string data = MemoUtil::getDataPath();
		unlink((data + "memo.db").c_str());
		ecore_file_recursive_rm((data + "media").c_str());
		vconf_unset("db/desktop/storage/internal_free_bytes");
		app = new MemoApp();
		app->onCreate();
		naviframe =
		    dynamic_cast<app_assist::WNaviframeController *>(app->getWindowController()->getBaseViewController());
		ASSERT_NE(naviframe, nullptr);
		// Popping the last page goes on and is noted, rather than ending the process.
		naviframe->setOnLastItemPop([this](bool *) { lastPagePopped = true; });
		win = app->getWindowController()->getEvasObj();
		render();
	}

	void TearDown() override
	{
		if (!terminated)
			app->onTerminate();
		delete app;
		app = nullptr;
		win = nullptr;
		preference_unset_changed_cb("MEMO_SVC_PROCESSING");
		preference_unset_changed_cb("CLOUD_TRIGGERING");
		records.clear();
		UiFixture::TearDown();
	}

	// Pushes the view and lets its idlers and the push settle.
	MemoEditView *push(MemoEditView *view)
	{
		EXPECT_TRUE(naviframe->push(view));
		settle();
		return view;
	}
	MemoEditView *openNew() { return push(new MemoEditView(nullptr, false, false)); }
	MemoEditView *openRecord(MemoDocInfo *record) { return push(new MemoEditView(record, false, false)); }

	void settle(double seconds = 0.4)
	{
		runFor(seconds);
		render();
	}

	// A stored memo read back as the list would give it; the fixture owns it.
	MemoDocInfo *storedMemo(const char *title, const std::string &todoList, const char *uuid = nullptr)
	{
		MemoDocInfo record;
		if (uuid)
			record.setMemoUUID(uuid);
		record.setTitle(title);
		record.setTizenXmlContent(todoList.c_str());
		record.setLastModifiedAt(1700000000000ULL);
		EXPECT_TRUE(MemoDbMgr::getInstance()->addMemo(&record));
		records.emplace_back(MemoDbMgr::getInstance()->getOneMemoN(record.getMemoUUID()));
		return records.back().get();
	}

	static std::string mediaDir(const char *uuid)
	{
		return std::string(MemoUtil::getDataPath()) + "media/" + uuid + "/";
	}

	// The scroller of the page and the item layouts in its box, title first.
	Evas_Object *contents(MemoEditView *view) const
	{
		return elm_object_part_content_get(view->getEvasObj(), "edit_view_contents");
	}
	std::vector<Evas_Object *> items(MemoEditView *view) const
	{
		std::vector<Evas_Object *> result;
		Eina_List *children = elm_box_children_get(elm_object_content_get(contents(view)));
		void *data = nullptr;
		EINA_LIST_FREE(children, data)
		result.push_back(static_cast<Evas_Object *>(data));
		return result;
	}
	// The entry of an item layout (its title or body entry), null when it has none.
	static Evas_Object *entryOf(Evas_Object *itemLayout)
	{
		Evas_Object *inner = elm_object_part_content_get(itemLayout, "content");
		Evas_Object *entry = inner ? elm_object_part_content_get(inner, "entry") : nullptr;
		return entry ? entry : (inner ? elm_object_part_content_get(inner, "title") : nullptr);
	}
	static std::string textOf(Evas_Object *entry)
	{
		const char *text = entry ? elm_entry_entry_get(entry) : nullptr;
		return text ? text : "";
	}
	Evas_Object *titleButton(MemoEditView *view, const char *part) const
	{
		return view->getNaviItem() ? elm_object_item_part_content_get(view->getNaviItem(), part) : nullptr;
	}

	void tapObject(Evas_Object *obj)
	{
		ASSERT_NE(obj, nullptr);
		int x = 0, y = 0;
		centreOf(obj, &x, &y);
		tap(x, y);
	}
	// Taps an entry and types into it, at its end.
	void typeInto(Evas_Object *itemLayout, const char *text)
	{
		Evas_Object *entry = entryOf(itemLayout);
		tapObject(entry);
		elm_entry_cursor_end_set(entry);
		typeText(text);
	}
	// A press and release on the empty area under the text, the release moved by (dx, dy).
	void pressUnderText(MemoEditView *view, int dx, int dy)
	{
		Evas_Coord x = 0, y = 0, w = 0, h = 0;
		evas_object_geometry_get(contents(view), &x, &y, &w, &h);
		mouseDown(x + w / 2, y + h - 80);
		mouseMove(x + w / 2 + dx, y + h - 80 + dy);
		mouseUp(x + w / 2 + dx, y + h - 80 + dy);
		settle(0.2);
	}
	void pressDone(MemoEditView *view) { tapObject(titleButton(view, "title_right_btn")); }
	// The answer of the open popup (1 or 2).
	Evas_Object *popupButton(int index)
	{
		app_assist::WViewController *popup = MemoPopupMonitor::getInstance()->getPopup();
		return popup ? elm_object_part_content_get(popup->getEvasObj(), ("button" + std::to_string(index)).c_str())
		             : nullptr;
	}
	bool isTop(MemoEditView *view) const { return naviframe->getTopContentViewController() == view; }

	// First column of the first row of a query on memo.db; "" when there is none.
	static std::string query(const std::string &sql)
	{
		std::string result;
		sqlite3 *db = nullptr;
		sqlite3_stmt *stmt = nullptr;
		const std::string path = std::string(MemoUtil::getDataPath()) + "memo.db";
		if (sqlite3_open_v2(path.c_str(), &db, SQLITE_OPEN_READWRITE, nullptr) == SQLITE_OK &&
		    sqlite3_prepare_v2(db, sql.c_str(), -1, &stmt, nullptr) == SQLITE_OK && sqlite3_step(stmt) == SQLITE_ROW &&
		    sqlite3_column_text(stmt, 0))
			result = reinterpret_cast<const char *>(sqlite3_column_text(stmt, 0));
		sqlite3_finalize(stmt);
		sqlite3_close(db);
		return result;
	}
	// From now on every insert or update of a memo row is counted in memoWrites().
	static void countWrites()
	{
		query("CREATE TABLE IF NOT EXISTS test_writes(n INTEGER)");
		query(
		    "CREATE TRIGGER IF NOT EXISTS test_ins AFTER INSERT ON memo BEGIN INSERT INTO test_writes VALUES(1); END");
		query(
		    "CREATE TRIGGER IF NOT EXISTS test_upd AFTER UPDATE ON memo BEGIN INSERT INTO test_writes VALUES(1); END");
	}
	static int memoWrites() { return atoi(query("SELECT count(*) FROM test_writes").c_str()); }

	MemoApp *app = nullptr;
	app_assist::WNaviframeController *naviframe = nullptr;
	bool lastPagePopped = false;
	bool terminated = false;
	std::vector<std::unique_ptr<MemoDocInfo>> records;
};

} // namespace memo_ui_test

#endif
