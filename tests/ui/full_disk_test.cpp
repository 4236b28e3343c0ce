// The data root on a small file system of its own, filled up: saving, inserting a picture and recording
// each stop with the storage popup, a write that gets through to the store fails without harming it, and
// once there is room again the next save lands. Needs the right to mount a tmpfs; skipped otherwise.
#include <app_i18n.h>

#include <fcntl.h>
#include <sys/mount.h>

#include <cerrno>
#include <cstring>

#include "TestEnv.h"
#include "box_control_fixture.h"
#include "support/EditViewAppsFixture.h"

using namespace memo_ui_test;

namespace
{
class FullDisk : public EditViewAppsFixture
{
protected:
	// Above the app's own limit of free space, so that freeing the filler makes room in its eyes too.
	static void SetUpTestSuite()
	{
		root = getenv("TIZEN_APP_ROOT");
		mounted = mount("memo-full-disk", root.c_str(), "tmpfs", MS_NOSUID | MS_NODEV, "size=128m,mode=0700") == 0;
		if (!mounted)
			why = strerror(errno);
	}
	static void TearDownTestSuite()
	{
		if (mounted)
			umount2(root.c_str(), MNT_DETACH);
	}
	void SetUp() override
	{
		if (!mounted)
			GTEST_SKIP() << "no tmpfs for the data root (" << why << "): the full disk is not tried";
		EditViewAppsFixture::SetUp();
	}
	void TearDown() override
	{
		if (mounted)
			EditViewAppsFixture::TearDown();
	}

	// Writes the filler until the file system takes no more.
	static void fill()
	{
		const int fd = open((root + "/filler").c_str(), O_WRONLY | O_CREAT | O_TRUNC, 0600);
		ASSERT_GE(fd, 0);
		static char block[1 << 16];
		for (size_t size = sizeof(block); size > 0; size /= 2) {
			while (write(fd, block, size) == static_cast<ssize_t>(size)) {
			}
		}
		close(fd);
	}

	// The storage popup is up; Cancel takes it down.
	void expectStoragePopup(const char *after)
	{
		settle();
		app_assist::WViewController *popup = MemoPopupMonitor::getInstance()->getPopup();
		ASSERT_NE(popup, nullptr) << "no popup after " << after;
		EXPECT_STREQ(i18n_get_text("IDS_IDLE_HEADER_NOT_ENOUGH_SPACE_ABB2"),
		             elm_object_part_text_get(popup->getEvasObj(), "title,text"))
		    << after;
		tapObject(popupButton(1));
		settle();
	}

	static inline std::string root, why;
	static inline bool mounted = false;
};
} // namespace

TEST_F(FullDisk, EveryWriteStopsWithTheMessageAndTheStoreStaysWhole)
{
	MemoDocInfo *kept = storedMemo("Kept", todoList(todoItem(0, false, "kept body")));
	const std::string keptBody =
	    "SELECT tizenXmlContent FROM memo WHERE UUID = '" + std::string(kept->getMemoUUID()) + "'";
	const std::string body = query(keptBody);
	MemoEditView *view = openNew();
	typeInto(items(view)[1], "no room");
	fill();

	pressDone(view);
	expectStoragePopup("Done");
	EXPECT_TRUE(isTop(view));
	openMenu();
	chooseMenu(i18n_get_text("IDS_MEMO_OPT_INSERT_IMAGE_ABB"));
	expectStoragePopup("inserting a picture");
	openMenu();
	chooseMenu(i18n_get_text("IDS_MEMO_OPT_RECORD_AUDIO_ABB2"));
	expectStoragePopup("recording");

	// A quick memo append has no space check of its own: the store refuses it (logged) and stays whole.
	MemoDbMgr::getInstance()->addQuickMemo("no room either");
	EXPECT_EQ(std::string::npos, query("SELECT content FROM memo WHERE isQuick = 1").find("no room either"));
	EXPECT_EQ("ok", query("PRAGMA integrity_check"));
	EXPECT_EQ(body, query(keptBody));
	EXPECT_NE(std::string::npos, body.find("kept body"));
	EXPECT_EQ("no room", textOf(entryOf(items(view)[1])));

	unlink((root + "/filler").c_str());
	pressDone(view);
	ASSERT_TRUE(waitFor([this] { return lastPagePopped; }));
	EXPECT_EQ("1", query("SELECT count(*) FROM memo WHERE content = 'no room'"));
	EXPECT_EQ("ok", query("PRAGMA integrity_check"));
}
