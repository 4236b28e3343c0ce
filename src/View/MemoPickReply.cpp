// The reply to a pick request: the memo's text with its check lines spelt out, and copies of its files in
// the shared area that other applications may read.
#include "View/MemoPickReply.h"

#include <cstdlib>
#include <cstring>
#include <string>

#include <Ecore_File.h>

#include "Box/MemoShareText.h"
#include "DataBase/MemoDbMgr.h"
#include "DataBase/MemoDocInfo.h"
#include "MemoLog.h"

namespace
{
const char MEDIA_PATH[] = "data/media";
const char SHARED_MEDIA_PATH[] = "shared/data/media";

// ".../data/media/<memo>/abcdXY.png" becomes ".../shared/data/media/<memo>/abcdXY/memo_media_XY.png", filled
// with a copy of the file unless an earlier pick made it already. A path outside the media folders stays.
std::string __sharedCopyOf(const std::string &path)
{
	size_t media = path.find(MEDIA_PATH);
	if (media == std::string::npos)
		return path;
	std::string shared = path;
	shared.replace(media, sizeof(MEDIA_PATH) - 1, SHARED_MEDIA_PATH);
	size_t dot = shared.rfind('.');
	if (dot != std::string::npos) {
		std::string key = shared.substr(dot >= 2 ? dot - 2 : 0, dot >= 2 ? 2 : dot);
		shared.replace(dot, 1, "/memo_media_" + key + ".");
	}
	if (!ecore_file_exists(shared.c_str())) {
		char *folder = ecore_file_dir_get(shared.c_str());
		if (folder)
			ecore_file_mkpath(folder);
		free(folder);
		if (!ecore_file_cp(path.c_str(), shared.c_str()))
			MEMO_LOGE("copy to %s failed", shared.c_str());
	}
	return shared;
}
} // namespace

void memoSendPickReply(MemoDocInfo *docInfo, app_control_h request)
{
	app_control_h reply = nullptr;
	app_control_create(&reply);
	if (!docInfo) {
		MEMO_LOGE("doc info is null");
		app_control_destroy(reply);
		return;
	}
	std::string text =
	    memoComposePickText(docInfo->getTitle(), docInfo->getTizenXmlContent(), docInfo->getDisplayContent());
	app_control_add_extra_data(reply, APP_CONTROL_DATA_TEXT, text.c_str());

	char **paths = nullptr;
	int count = 0;
	MemoDbMgr::getInstance()->getFilePathsN(docInfo->getMemoUUID(), &paths, &count);
	for (int i = 0; i < count; ++i) {
		std::string shared = __sharedCopyOf(paths[i]);
		free(paths[i]);
		paths[i] = strdup(shared.c_str());
	}
	if (count > 0) {
		app_control_add_extra_data_array(reply, APP_CONTROL_DATA_PATH, const_cast<const char **>(paths), count);
		for (int i = 0; i < count; ++i)
			free(paths[i]);
	}
	free(paths);
	app_control_reply_to_launch_request(reply, request, APP_CONTROL_RESULT_SUCCEEDED);
	app_control_destroy(reply);
}
