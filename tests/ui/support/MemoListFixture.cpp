// Scaffolding of the memo list tests.
#include "MemoListFixture.h"

#include <clocale>

#include <app_common.h>
#include <app_control.h>
#include <app_preference.h>
#include <uxt_theme.h>
#include <vconf.h>

#include <WNaviframeController.h>
#include <WWindowController.h>

#include "DataBase/MemoDbMgr.h"
#include "DataBase/MemoDocInfo.h"
#include "Model/MemoBroadCaster.h"
#include "Model/MemoPopupMonitor.h"
#include "TestEnv.h"
#include "Util/MemoUtil.h"
#include "View/MemoListView.h"

namespace memo_ui_test
{

namespace
{
unsigned long long gLastModified = 1600000000000ULL;

std::string takeN(char *text)
{
	std::string result = text ? text : "";
	free(text);
	return result;
}
} // namespace

std::string dataPath()
{
	return takeN(app_get_data_path());
}

std::string checkLines(const std::vector<std::string> &lines)
{
	std::string display;
	for (const std::string &line : lines) {
		if (line[0] == '+' || line[0] == '-')
			display += std::string(line[0] == '+' ? "<CHECK state=true>" : "<CHECK state=false>") + line.substr(1) +
			           "</CHECK>";
		else
			display += (display.empty() || display.back() == '>' ? "" : "\n") + line;
	}
	return display;
}

void resetStore()
{
	MemoDbMgr::destroy();
	const std::string data = dataPath();
	const std::string shared = takeN(app_get_shared_data_path());
	memo_test::runCommand("rm -rf '" + data + "memo.db' '" + data + "media' '" + shared + "media'");
	for (const char *key : {"db/desktop/account/list", "db/desktop/csc/feature_92", "db/memo/data-change",
	                        "db/desktop/storage/internal_free_bytes", "db/setting/psmode"})
		vconf_unset(key);
}

std::string addMemo(const TestMemo &memo)
{
	MemoDocInfo *info = new MemoDocInfo();
	// Titles come from the editor as markup.
	char *title = elm_entry_utf8_to_markup(memo.title.c_str());
	info->setTitle(title);
	free(title);
	info->setDisplayContent(memo.display.c_str());
	info->setStrippedContent(memo.display.c_str());
	std::string document = memo.tizenXml;
	if (document.empty() && !memo.display.empty())
		document = "<todolist></todolist>";
	info->setTizenXmlContent(document.c_str());
	info->setVrfileUUID(memo.voiceUuid.c_str());
	info->setData(memo.thumbnail.c_str());
	if (!memo.bgColor.empty())
		info->setBgColor(memo.bgColor.c_str());
	info->setIsFavorite(memo.isFavourite);
	info->setIsHidden(memo.isHidden);
	gLastModified += 1000;
	info->setCreatedAt(gLastModified);
	info->setLastModifiedAt(gLastModified);
	std::string uuid = info->getMemoUUID();
	EXPECT_TRUE(MemoDbMgr::getInstance()->addMemo(info));
	delete info;
	return uuid;
}

void GridFixture::SetUp()
{
	UiFixture::SetUp();
	// The colour table, as the app sets it.
	static Uxt_Theme_Color_Table *table = nullptr;
	if (!table) {
		table = uxt_theme_add_color_table(
		    (std::string(MemoUtil::getResourcePath()) + "table/memo_color_table.xml").c_str());
		uxt_theme_set_color_table(table);
	}
	setenv("LANGUAGE", "en", 1);
	elm_app_base_scale_set(2.6);
	gIsPortrait = 1;
	resetStore();
	resizeWindow(480, 800);
}

void GridFixture::TearDown()
{
	grid = nullptr;
	UiFixture::TearDown();
	MemoDbMgr::destroy();
}

void GridFixture::resizeWindow(int w, int h)
{
	evas_sync(evas());
	evas_object_resize(win, w, h);
}

MemoGridControl *GridFixture::makeGrid(int *mode)
{
	grid = new MemoGridControl();
	EXPECT_TRUE(grid->create(win, mode));
	elm_win_resize_object_add(win, grid->getEvasObj());
	grid->updateGrid();
	render();
	return grid;
}

Elm_Object_Item *GridFixture::cardAt(int index)
{
	render();
	Elm_Object_Item *item = elm_gengrid_first_item_get(grid->getEvasObj());
	for (int i = 0; item && i < index; ++i)
		item = elm_gengrid_item_next_get(item);
	return item;
}

std::string GridFixture::cardText(Elm_Object_Item *card, const char *part)
{
	const char *text = card ? elm_object_item_part_text_get(card, part) : nullptr;
	return text ? text : "";
}

Evas_Object *GridFixture::cardContent(Elm_Object_Item *card, const char *part)
{
	return card ? elm_object_item_part_content_get(card, part) : nullptr;
}

std::string GridFixture::layoutText(Evas_Object *layout, const char *part)
{
	const char *text = layout ? elm_object_part_text_get(layout, part) : nullptr;
	return text ? text : "";
}

void ListViewFixture::SetUp()
{
	UiFixture::SetUp();
	// The app makes its own window; the helpers of UiFixture act on that one.
	evas_sync(evas());
	evas_object_del(win);
	win = scroller = nullptr;
	// As the platform sets the device language: C.UTF-8, under which gettext honours LANGUAGE.
	setenv("LANGUAGE", "en", 1);
	setlocale(LC_MESSAGES, "C.UTF-8");
	gIsPortrait = 1;
	resetStore();
}

void ListViewFixture::TearDown()
{
	if (app) {
		evas_sync(evas());
		app->onTerminate();
		delete app;
		app = nullptr;
	}
	win = nullptr;
	preference_unset_changed_cb("MEMO_SVC_PROCESSING");
	preference_unset_changed_cb("CLOUD_TRIGGERING");
	UiFixture::TearDown();
}

void ListViewFixture::startApp(const char *operation)
{
	__logStart = memo_test::readFile(dataPath() + "dlog.log").size();
	app = new MemoApp();
	ASSERT_TRUE(app->onCreate());
	win = app->getWindowController()->getEvasObj();
	app_control_h request = nullptr;
	app_control_create(&request);
	if (operation)
		app_control_set_operation(request, operation);
	app->onAppControl(request, true);
	app_control_destroy(request);
	// The platform resumes the app after its first request.
	app->onResume();
	runFor(0.05);
	render();
}

app_assist::WNaviframeController *ListViewFixture::naviframe()
{
	return dynamic_cast<app_assist::WNaviframeController *>(app->getWindowController()->getBaseViewController());
}

MemoListView *ListViewFixture::listView()
{
	return dynamic_cast<MemoListView *>(naviframe()->getTopContentViewController());
}

Evas_Object *ListViewFixture::gengrid()
{
	MemoListView *view = listView();
	Evas_Object *content = view ? elm_object_part_content_get(view->getEvasObj(), "contents") : nullptr;
	const char *type = content ? elm_object_widget_type_get(content) : nullptr;
	return (type && std::string(type).find("Gengrid") != std::string::npos) ? content : nullptr;
}

Evas_Object *ListViewFixture::floatingButton()
{
	Evas_Object *base = app->getWindowController()->getBaseLayoutEvasObj();
	Evas_Object *floating = elm_object_part_content_get(base, "elm.swallow.floatingbutton");
	return (floating && evas_object_visible_get(floating)) ? elm_object_part_content_get(floating, "button1") : nullptr;
}

void ListViewFixture::tapCard(int index)
{
	Evas_Object *grid = gengrid();
	ASSERT_NE(grid, nullptr);
	Elm_Object_Item *item = elm_gengrid_first_item_get(grid);
	for (int i = 0; item && i < index; ++i)
		item = elm_gengrid_item_next_get(item);
	ASSERT_NE(item, nullptr);
	elm_gengrid_item_show(item, ELM_GENGRID_ITEM_SCROLLTO_IN);
	render();
	Evas_Object *card = elm_object_item_track(item);
	int x = 0, y = 0;
	centreOf(card, &x, &y);
	elm_object_item_untrack(item);
	tap(x, y);
	runFor(0.2);
}

std::string ListViewFixture::logSince()
{
	std::string log = memo_test::readFile(dataPath() + "dlog.log");
	return log.size() > __logStart ? log.substr(__logStart) : "";
}

} // namespace memo_ui_test
