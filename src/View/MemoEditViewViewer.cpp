// A picture of the memo opened in the image viewer. Reading, the viewer shows the memo's own file; editing, it
// shows a copy and may answer that the user deleted the picture, which then leaves the text. The file itself
// stays until the save tidies the media folder.
#include "View/MemoEditView.h"

#include <cstdlib>
#include <cstring>
#include <string>

#include <Ecore_File.h>
#include <WUiTimer.h>
#include <app_common.h>

#include "MemoLog.h"

using app_assist::WUiTimer;
using app_assist::WViewControllerWeakPtr;

static const char *const IMAGE_VIEWER_APP_ID = "com.veltron.image-viewer";
// Another picture may be opened this long after a launch.
static const double LAUNCH_GUARD = 1.0;

void MemoEditView::__onImageSelected(const char *path)
{
	if (!path)
		return;
	app_control_h request = nullptr;
	if (__mode == MODE_VIEW) {
		if (app_control_create(&request) != APP_CONTROL_ERROR_NONE) {
			MEMO_LOGE("app_control_create failed.");
			return;
		}
		app_control_set_app_id(request, IMAGE_VIEWER_APP_ID);
		app_control_set_operation(request, APP_CONTROL_OPERATION_VIEW);
		app_control_set_launch_mode(request, APP_CONTROL_LAUNCH_MODE_GROUP);
		app_control_set_uri(request, path);
		app_control_add_extra_data(request, "View Mode", "DISPLAY");
		if (app_control_send_launch_request(request, nullptr, nullptr) != APP_CONTROL_ERROR_NONE)
			MEMO_LOGE("the image viewer could not be launched");
		app_control_destroy(request);
		return;
	}

	if (__viewerPopup) {
		evas_object_del(__viewerPopup);
		__viewerPopup = nullptr;
	}
	if (__isLaunching) {
		MEMO_LOGI("Skipped during launching image viewer.");
		return;
	}
	__isLaunching = true;

	// The viewer gets a copy in the shared folder, which it may read.
	char *shared = app_get_shared_data_path();
	const std::string folder = std::string(shared ? shared : "") + "view/";
	free(shared);
	if (!ecore_file_mkpath(folder.c_str()) && !ecore_file_is_dir(folder.c_str()))
		MEMO_LOGE("ecore_file_mkpath fail!!");
	const std::string copy = folder + ecore_file_file_get(path);
	if (!ecore_file_exists(copy.c_str()))
		ecore_file_cp(path, copy.c_str());
	free(__viewerCopyPath);
	__viewerCopyPath = strdup(copy.c_str());

	if (app_control_create(&request) != APP_CONTROL_ERROR_NONE) {
		MEMO_LOGE("app_control_create failed.");
	} else {
		app_control_set_app_id(request, IMAGE_VIEWER_APP_ID);
		app_control_set_operation(request, APP_CONTROL_OPERATION_VIEW);
		app_control_set_launch_mode(request, APP_CONTROL_LAUNCH_MODE_GROUP);
		app_control_set_uri(request, __viewerCopyPath);
		app_control_add_extra_data(request, "DeleteMenu", "TRUE");
		WViewControllerWeakPtr *page = new WViewControllerWeakPtr(getWeakPtr());
		if (app_control_send_launch_request(request, __imageViewerCb, page) != APP_CONTROL_ERROR_NONE) {
			MEMO_LOGE("the image viewer could not be launched");
			delete page;
		}
		app_control_destroy(request);
	}

	WUiTimer::addIdler(
	    [this](void *) {
		    if (__boxControl)
			    __boxControl->resumeKeypad();
		    return false;
	    },
	    nullptr, getEvasObj());
	WUiTimer::addTimer(
	    LAUNCH_GUARD,
	    [this](void *) {
		    __isLaunching = false;
		    return false;
	    },
	    nullptr, getEvasObj());
}

void MemoEditView::__imageViewerCb(app_control_h request, app_control_h reply, app_control_result_e result, void *data)
{
	(void)result;
	WViewControllerWeakPtr *page = static_cast<WViewControllerWeakPtr *>(data);
	MemoEditView *self = page ? dynamic_cast<MemoEditView *>(page->lock().get()) : nullptr;
	delete page;
	if (!self) {
		MEMO_LOGE("self is NULL");
		return;
	}
	char *deleted = nullptr;
	app_control_get_extra_data(reply, "DeleteMenu", &deleted);
	const bool remove = deleted && !strcmp(deleted, "TRUE");
	free(deleted);
	if (!remove)
		return;
	char *uri = nullptr;
	app_control_get_uri(request, &uri);
	if (uri && self->__boxControl) {
		// The picture is known by its file name without the extension.
		std::string uuid = ecore_file_file_get(uri);
		const size_t dot = uuid.rfind('.');
		if (dot != std::string::npos)
			uuid.erase(dot);
		self->__boxControl->deleteImage(uuid.c_str());
	}
	free(uri);
}
