// Sharing a memo from the edit view: the text other apps get, the copies of its files that they may read, and
// the launch that hands both over.
#include "View/MemoEditView.h"

#include <cstdlib>
#include <cstring>
#include <string>

#include <Ecore_File.h>

#include "Box/MemoShareText.h"
#include "DataBase/MemoDbMgr.h"
#include "DataBase/MemoDocInfo.h"
#include "MemoLog.h"

// Files of the app's data folder and their copies under the shared data folder.
static const char *const PRIVATE_MEDIA = "data/media";
static const char *const SHARED_MEDIA = "shared/data/media";

std::string MemoEditView::__getShareText()
{
	if (!__info)
		return memoComposeEditShareText(nullptr, nullptr, __displayContent);
	return memoComposeEditShareText(__info->getTitle(), __info->getTizenXmlContent(), __displayContent);
}

bool MemoEditView::__hasVisibleText(const std::string &text)
{
	return text.find_first_not_of("\n ") != std::string::npos;
}

namespace
{
// "<root>/data/media/<memo>/<name>XY.jpg" becomes "<root>/shared/data/media/<memo>/<name>XY/memo_media_XY.jpg":
// each copy has a folder of its own named after the file, and a name that says where it came from.
std::string sharedCopyPath(const std::string &path)
{
	std::string copy = path;
	const size_t media = copy.find(PRIVATE_MEDIA);
	copy.replace(media, strlen(PRIVATE_MEDIA), SHARED_MEDIA);
	const size_t dot = copy.rfind('.');
	if (dot == std::string::npos || dot < 2)
		return copy;
	const std::string tail = copy.substr(dot - 2, 2);
	copy.replace(dot, 1, "/memo_media_" + tail + ".");
	return copy;
}
} // namespace

char **MemoEditView::__getSharedCopiesN(int *count)
{
	char **paths = nullptr;
	*count = 0;
	MemoDbMgr *db = MemoDbMgr::getInstance();
	if (!db || !db->getFilePathsN(__UUID, &paths, count) || *count <= 0) {
		*count = 0;
		return nullptr;
	}
	for (int i = 0; i < *count; i++) {
		if (!paths[i] || !strstr(paths[i], PRIVATE_MEDIA))
			continue;
		const std::string copy = sharedCopyPath(paths[i]);
		if (!ecore_file_exists(copy.c_str())) {
			char *folder = ecore_file_dir_get(copy.c_str());
			if (folder)
				ecore_file_mkpath(folder);
			free(folder);
			// A failed copy still goes out by its path.
			if (!ecore_file_cp(paths[i], copy.c_str()))
				MEMO_LOGE("could not copy %s to share it", paths[i]);
		}
		free(paths[i]);
		paths[i] = strdup(copy.c_str());
	}
	return paths;
}

void MemoEditView::__shareMemo()
{
	const std::string text = __getShareText();
	const bool hasText = __hasVisibleText(text);
	int count = 0;
	char **paths = __getSharedCopiesN(&count);
	if (!hasText && count == 0) {
		MEMO_LOGI("nothing to share");
		return;
	}

	app_control_h request = nullptr;
	if (app_control_create(&request) != APP_CONTROL_ERROR_NONE) {
		MEMO_LOGE("app_control_create failed.");
	} else {
		app_control_set_launch_mode(request, APP_CONTROL_LAUNCH_MODE_GROUP);
		if (hasText) {
			// Text, with the files beside it when there are any.
			app_control_set_operation(request, APP_CONTROL_OPERATION_SHARE_TEXT);
			app_control_add_extra_data(request, APP_CONTROL_DATA_TEXT, text.c_str());
		} else {
			// Files alone: the first one names the share.
			app_control_set_operation(request, APP_CONTROL_OPERATION_MULTI_SHARE);
			const std::string uri = std::string("file://") + paths[0];
			app_control_set_uri(request, uri.c_str());
		}
		if (count > 0)
			app_control_add_extra_data_array(request, APP_CONTROL_DATA_PATH, const_cast<const char **>(paths), count);
		const int ret = app_control_send_launch_request(request, nullptr, nullptr);
		if (ret != APP_CONTROL_ERROR_NONE)
			MEMO_LOGE("share launch failed (%d)", ret);
		app_control_destroy(request);
	}
	for (int i = 0; i < count; i++)
		free(paths[i]);
	free(paths);
}
