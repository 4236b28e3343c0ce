// A pick request from another process, through app_launcher, to a running memo app (this process, started
// through the platform loop and waiting for the request that starts it). A tap on a card answers it with the
// memo's text, "[ ]"/"[V]" for its check lines, and the paths of shared copies of its files.
#include <gtest/gtest.h>

#include <Ecore_File.h>
#include <Elementary.h>
#include <app_common.h>
#include <app_preference.h>

#include <cstdlib>
#include <cstring>
#include <string>

#include <WNaviframeController.h>
#include <WWindowController.h>

#include "DataBase/MemoDbMgr.h"
#include "DataBase/MemoDocInfo.h"
#include "List/MemoGridItem.h"
#include "MemoApp.h"
#include "TestEnv.h"
#include "Util/MemoUtil.h"
#include "View/MemoListView.h"

namespace
{

const char PICK[] = "http://tizen.org/appcontrol/operation/pick";
const char TEXT_KEY[] = "http://tizen.org/appcontrol/data/text=";
const char PATH_KEY[] = "http://tizen.org/appcontrol/data/path=";

std::string takeN(char *text)
{
	std::string result = text ? text : "";
	free(text);
	return result;
}

// The app of one run: once the first request has put the list on screen, taps the card of `uuid`; with a
// query, first opens the search from the more menu and types the query into its field.
class PickingApp : public MemoApp
{
public:
	PickingApp(std::string uuid, std::string launcherOut, std::string query = "")
	    : __uuid(std::move(uuid)), __out(std::move(launcherOut)), __query(std::move(query))
	{
	}
	~PickingApp() override
	{
		if (__timer)
			ecore_timer_del(__timer);
	}

	bool onCreate() override
	{
		bool created = MemoApp::onCreate();
		// Taking requests already: the launcher finds this process running.
		memo_test::runCommand("env -u TIZEN_APP_ID '" TEST_BIN_DIR "/app_launcher' -s com.veltron.memo -o " +
		                      std::string(PICK) + " -r -t 20 > '" + __out + "' 2>&1 &");
		return created;
	}
	void onAppControl(app_control_s *request, bool firstLaunch) override
	{
		MemoApp::onAppControl(request, firstLaunch);
		char *operation = nullptr;
		app_control_get_operation(request, &operation);
		pickedFirst = firstLaunch && operation && std::string(operation) == PICK;
		free(operation);
		__timer = ecore_timer_add(0.2, __stepCb, this);
	}

	// The platform ends its connections right after the loop: a reply sent on the way out can reach the
	// launcher after the end of the connection, which reads as "canceled" (see the report on the launch
	// channel). The test lets the reply go first.
	void onTerminate() override
	{
		memo_test::pumpFor(0.1);
		MemoApp::onTerminate();
	}

	bool pickedFirst = false;
	bool floatingButtonSeen = false;
	bool tapped = false;
	bool searched = false;

private:
	static Eina_Bool __stepCb(void *data)
	{
		PickingApp *self = static_cast<PickingApp *>(data);
		self->__timer = nullptr;
		const double next = self->__step();
		if (next > 0)
			self->__timer = ecore_timer_add(next, __stepCb, self);
		return ECORE_CALLBACK_CANCEL;
	}

	// One step of the run; returns the wait before the next one, 0 at the end.
	double __step()
	{
		app_assist::WWindowController *window = getWindowController();
		auto *naviframe = dynamic_cast<app_assist::WNaviframeController *>(window->getBaseViewController());
		app_assist::WContentViewController *top = naviframe->getTopContentViewController();
		Evas *evas = evas_object_evas_get(window->getEvasObj());
		switch (__stepIndex++) {
		case 0:
			floatingButtonSeen =
			    elm_object_part_content_get(window->getBaseLayoutEvasObj(), "elm.swallow.floatingbutton") != nullptr;
			if (!__query.empty()) {
				evas_event_feed_key_down(evas, "F2", "F2", nullptr, nullptr, 10, nullptr);
				evas_event_feed_key_up(evas, "F2", "F2", nullptr, nullptr, 11, nullptr);
				return 0.3;
			}
			__stepIndex = 3;
			return __step();
		case 1: {
			// The menu's rows are those of a list inside it.
			Evas_Object *menu = top->getPopup() ? elm_object_content_get(top->getPopup()->getEvasObj()) : nullptr;
			Elm_Object_Item *row = menu ? elm_list_last_item_get(menu) : nullptr;
			if (row) {
				__tapAt(evas, elm_object_item_track(row));
				elm_object_item_untrack(row);
			}
			return 0.6;
		}
		case 2: {
			Evas_Object *bar = elm_object_item_part_content_get(top->getNaviItem(), "title");
			Evas_Object *entry = bar ? elm_object_part_content_get(bar, "elm.swallow.searchbar") : nullptr;
			searched = entry != nullptr;
			evas_focus_in(evas);
			elm_object_focus_set(entry, EINA_TRUE);
			for (char c : __query) {
				const char key[2] = {c, '\0'};
				evas_event_feed_key_down(evas, key, key, key, key, 20, nullptr);
				evas_event_feed_key_up(evas, key, key, key, key, 21, nullptr);
			}
			return 0.3;
		}
		default:
			__tapCard(elm_object_part_content_get(top->getEvasObj(), "contents"));
			return 0;
		}
	}

	void __tapCard(Evas_Object *grid)
	{
		for (Elm_Object_Item *item = elm_gengrid_first_item_get(grid); item; item = elm_gengrid_item_next_get(item)) {
			auto *card = static_cast<MemoGridItem *>(elm_object_item_data_get(item));
			if (!card || __uuid != card->getDocInfo()->getMemoUUID())
				continue;
			__tapAt(evas_object_evas_get(grid), elm_object_item_track(item));
			elm_object_item_untrack(item);
			tapped = true;
			return;
		}
	}

	static void __tapAt(Evas *evas, Evas_Object *target)
	{
		int x, y, w, h;
		evas_object_geometry_get(target, &x, &y, &w, &h);
		evas_event_feed_mouse_move(evas, x + w / 2, y + h / 2, 100, nullptr);
		evas_event_feed_mouse_down(evas, 1, EVAS_BUTTON_NONE, 101, nullptr);
		evas_event_feed_mouse_up(evas, 1, EVAS_BUTTON_NONE, 102, nullptr);
	}

	std::string __uuid;
	std::string __out;
	std::string __query;
	int __stepIndex = 0;
	Ecore_Timer *__timer = nullptr;
};

class ListPickTest : public ::testing::Test
{
protected:
	static void SetUpTestSuite()
	{
		static char arg0[] = "list-pick-test";
		static char *argv[] = {arg0, nullptr};
		elm_init(1, argv);
	}

	void SetUp() override
	{
		MemoDbMgr::destroy();
		dataPath = takeN(app_get_data_path());
		memo_test::runCommand("rm -rf '" + dataPath + "memo.db' '" + dataPath + "media' '" +
		                      takeN(app_get_shared_data_path()) + "media'");
	}

	// A memo with a title, three check lines and the given files (written to its media folder).
	std::string addMemo(const char *title, const std::vector<std::string> &fileNames)
	{
		MemoDocInfo info;
		info.setTitle(title);
		info.setTizenXmlContent("<todolist></todolist>");
		info.setDisplayContent("Shopping<CHECK state=false>milk</CHECK><CHECK state=true>eggs</CHECK>");
		info.setLastModifiedAt(1600000000000ULL + fileNames.size());
		std::string uuid = info.getMemoUUID();
		info.setFileCount(static_cast<int>(fileNames.size()));
		for (size_t i = 0; i < fileNames.size(); ++i) {
			std::string path = dataPath + "media/" + uuid + "/" + fileNames[i];
			ecore_file_mkpath((dataPath + "media/" + uuid).c_str());
			memo_test::runCommand("printf picture-" + std::to_string(i) + " > '" + path + "'");
			char *fileUuid = nullptr;
			MemoUtil::createUUIDN(&fileUuid);
			info.getFiles()[i].setFileUUID(fileUuid);
			free(fileUuid);
			info.getFiles()[i].setMemoUUID(uuid.c_str());
			info.getFiles()[i].setPath(path.c_str());
		}
		EXPECT_TRUE(MemoDbMgr::getInstance()->addMemo(&info));
		MemoDbMgr::destroy();
		return uuid;
	}

	// Runs the app until the pick has been answered and the app has ended; returns the launcher's output.
	std::string pick(const std::string &uuid, const std::string &query = "")
	{
		std::string out = memo_test::makeTempDir("pick") + "/launcher.txt";
		setenv("TIZEN_APP_LAUNCH_WAIT", "1", 1);
		static char arg0[] = "memo";
		static char *argv[] = {arg0, nullptr};
		{
			PickingApp app(uuid, out, query);
			EXPECT_EQ(APP_ERROR_NONE, app.start(1, argv));
			EXPECT_TRUE(app.pickedFirst);
			EXPECT_EQ(!query.empty(), app.searched);
			EXPECT_TRUE(app.tapped);
			EXPECT_FALSE(app.floatingButtonSeen);
		}
		preference_unset_changed_cb("MEMO_SVC_PROCESSING");
		preference_unset_changed_cb("CLOUD_TRIGGERING");
		MemoDbMgr::destroy();
		memo_test::pump(10.0, [&] { return memo_test::readFile(out).find("result=") != std::string::npos; });
		memo_test::pumpFor(0.2);
		return memo_test::readFile(out);
	}

	static std::string valueOf(const std::string &reply, const char *key)
	{
		size_t at = reply.find(key);
		if (at == std::string::npos)
			return "<none>";
		at += strlen(key);
		// A value runs to the next key or the end; the text holds line ends of its own.
		size_t end = reply.find("\nhttp://tizen.org/appcontrol/data/", at);
		return reply.substr(at, end == std::string::npos ? std::string::npos : end - at);
	}

	std::string dataPath;
};

TEST_F(ListPickTest, pickAnswersWithTextAndSharedCopiesThatLaterPicksReuse)
{
	std::string plain = addMemo("Plain", {});
	std::string withFiles = addMemo("Trip", {"photoAB.jpg", "voiceCD.amr"});

	std::string reply = pick(withFiles);
	EXPECT_NE(std::string::npos, reply.find("result=succeeded")) << reply;
	EXPECT_EQ("Trip\nShopping[ ]milk\n[V]eggs\n\n", valueOf(reply, TEXT_KEY).append("\n"));
	const std::string root = dataPath.substr(0, dataPath.rfind("data/"));
	const std::string shared = root + "shared/data/media/" + withFiles + "/";
	const std::string copyA = shared + "photoAB/memo_media_AB.jpg";
	const std::string copyC = shared + "voiceCD/memo_media_CD.amr";
	EXPECT_EQ(copyA + "," + copyC + "\n", valueOf(reply, PATH_KEY));
	EXPECT_EQ("picture-0", memo_test::readFile(copyA));
	EXPECT_EQ("picture-1", memo_test::readFile(copyC));

	// The second pick finds the copies in place and leaves them as they are.
	memo_test::runCommand("printf kept > '" + copyA + "'");
	reply = pick(withFiles);
	EXPECT_NE(std::string::npos, reply.find(copyA));
	EXPECT_EQ("kept", memo_test::readFile(copyA));

	// A memo without files: the text alone.
	reply = pick(plain);
	EXPECT_NE(std::string::npos, reply.find("Plain\nShopping[ ]milk")) << reply;
	EXPECT_EQ(std::string::npos, reply.find(PATH_KEY));

	// A search in the pick answers the same request.
	reply = pick(plain, "lai");
	EXPECT_NE(std::string::npos, reply.find("result=succeeded")) << reply;
	EXPECT_NE(std::string::npos, reply.find("Plain\nShopping[ ]milk")) << reply;
}

} // namespace
