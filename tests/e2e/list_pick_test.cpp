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

// The app of one run: once the first request has put the list on screen, taps the card of `uuid`.
class PickingApp : public MemoApp
{
public:
	PickingApp(std::string uuid, std::string launcherOut) : __uuid(std::move(uuid)), __out(std::move(launcherOut)) {}
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
		__timer = ecore_timer_add(0.2, __tapCb, this);
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

private:
	static Eina_Bool __tapCb(void *data)
	{
		PickingApp *self = static_cast<PickingApp *>(data);
		self->__timer = nullptr;
		self->__tapCard();
		return ECORE_CALLBACK_CANCEL;
	}

	void __tapCard()
	{
		app_assist::WWindowController *window = getWindowController();
		auto *naviframe = dynamic_cast<app_assist::WNaviframeController *>(window->getBaseViewController());
		auto *list = dynamic_cast<MemoListView *>(naviframe->getTopContentViewController());
		ASSERT_NE(nullptr, list);
		Evas_Object *base = window->getBaseLayoutEvasObj();
		floatingButtonSeen = elm_object_part_content_get(base, "elm.swallow.floatingbutton") != nullptr;
		Evas_Object *grid = elm_object_part_content_get(list->getEvasObj(), "contents");
		for (Elm_Object_Item *item = elm_gengrid_first_item_get(grid); item; item = elm_gengrid_item_next_get(item)) {
			auto *card = static_cast<MemoGridItem *>(elm_object_item_data_get(item));
			if (!card || __uuid != card->getDocInfo()->getMemoUUID())
				continue;
			Evas_Object *track = elm_object_item_track(item);
			int x, y, w, h;
			evas_object_geometry_get(track, &x, &y, &w, &h);
			elm_object_item_untrack(item);
			Evas *evas = evas_object_evas_get(grid);
			evas_event_feed_mouse_move(evas, x + w / 2, y + h / 2, 100, nullptr);
			evas_event_feed_mouse_down(evas, 1, EVAS_BUTTON_NONE, 101, nullptr);
			evas_event_feed_mouse_up(evas, 1, EVAS_BUTTON_NONE, 102, nullptr);
			tapped = true;
			return;
		}
	}

	std::string __uuid;
	std::string __out;
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
	std::string pick(const std::string &uuid)
	{
		std::string out = memo_test::makeTempDir("pick") + "/launcher.txt";
		setenv("TIZEN_APP_LAUNCH_WAIT", "1", 1);
		static char arg0[] = "memo";
		static char *argv[] = {arg0, nullptr};
		{
			PickingApp app(uuid, out);
			EXPECT_EQ(APP_ERROR_NONE, app.start(1, argv));
			EXPECT_TRUE(app.pickedFirst);
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
}

} // namespace
