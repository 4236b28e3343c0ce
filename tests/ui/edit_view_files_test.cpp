// The files of a saved memo: image rows, the thumbnail and the media folder.
#include "box_control_fixture.h"
#include "support/EditViewFixture.h"

using namespace memo_ui_test;

namespace
{
using EditViewFiles = EditViewFixture;
}

// Ten pictures in the body (the editor takes no more), the first one gone from the disk, and a file nothing
// refers to.
TEST_F(EditViewFiles, TenPictureRowsThumbnailFromTheFirstThatExistsStaleFileGoes)
{
	char *uuid = nullptr;
	ASSERT_TRUE(MemoUtil::createUUIDN(&uuid));
	const std::string folder = mediaDir(uuid);
	ecore_file_mkpath(folder.c_str());
	std::string body;
	for (int i = 0; i < 10; i++) {
		const std::string path = folder + "picture" + std::to_string(i) + ".jpg";
		if (i > 0) {
			ASSERT_TRUE(writePicture(path, 200, 150));
		}
		body += tag(200, 150, path);
	}
	ASSERT_TRUE(writePicture(folder + "stale.jpg", 50, 50));

	MemoEditView *view = openRecord(storedMemo("", todoList(todoItem(0, false, "pictures" + body)), uuid));
	pressUnderText(view, 0, 0);
	typeInto(items(view)[1], "!");
	pressDone(view);
	ASSERT_TRUE(waitFor([this] { return lastPagePopped; }));

	const std::string memo = std::string("'") + uuid + "'";
	free(uuid);
	EXPECT_EQ("10", query("SELECT count(*) FROM file WHERE memoUUID = " + memo));
	for (int i = 1; i < 10; i++)
		EXPECT_TRUE(ecore_file_exists((folder + "picture" + std::to_string(i) + ".jpg").c_str())) << i;
	EXPECT_FALSE(ecore_file_exists((folder + "stale.jpg").c_str()));
	const std::string thumbnail = query("SELECT _data FROM memo WHERE UUID = " + memo);
	EXPECT_EQ(folder + "thumb/" + memo.substr(1, memo.size() - 2) + ".jpg", thumbnail);
	EXPECT_TRUE(ecore_file_exists(thumbnail.c_str()));
}
