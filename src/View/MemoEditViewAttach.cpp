// The attach panel of the edit view: pictures picked in a panel at the foot of the window, copied into the
// memo's media folder and shrunk on a worker, then put in the text together. No flow of the app opens the
// panel today; closing and asking after it are part of Done, Cancel and the more menu.
#include "View/MemoEditView.h"

#include <cstdlib>
#include <cstring>
#include <string>

#include <Ecore_File.h>
#include <WUiTimer.h>
#include <WWindowController.h>
#include <app_i18n.h>
#include <notification.h>
#include <uxt_scroller.h>

#include "MemoEditViewImageJob.h"
#include "MemoLog.h"
#include "Util/MemoUtil.h"

using app_assist::WUiTimer;

static const int IMAGE_LIMIT = 10;
// The worker starts once the progress popup has been seen.
static const double WORKER_DELAY = 0.1;
static const double AFTER_INSERT_DELAY = 1.0;

// The room left for pictures, under both keys the panel reads.
bundle *MemoEditView::__attachRoomBundleN()
{
	bundle *room = bundle_create();
	const std::string left = std::to_string(IMAGE_LIMIT - __getImageCount());
	bundle_add_str(room, "max-count", left.c_str());
	bundle_add_str(room, APP_CONTROL_DATA_TOTAL_COUNT, left.c_str());
	return room;
}

void MemoEditView::__createAttachPanel()
{
	if (__attachPanel) {
		MEMO_LOGI("attach panel already existed");
		bool visible = false;
		if (attach_panel_get_visibility(__attachPanel, &visible) != ATTACH_PANEL_ERROR_NONE)
			MEMO_LOGE("Fail to get visible of attach panel");
		if (!visible) {
			MEMO_LOGI("attach panel state : hide->show");
			attach_panel_show(__attachPanel);
		}
		return;
	}
	app_assist::WWindowController *window = getWindowController();
	Evas_Object *conformant = window ? window->getConformantEvasObj() : nullptr;
	if (attach_panel_create(conformant, &__attachPanel) != ATTACH_PANEL_ERROR_NONE) {
		MEMO_LOGE("attach_panel_create failed.");
		__attachPanel = nullptr;
		return;
	}
	bundle *room = __attachRoomBundleN();
	bundle *camera = bundle_create();
	bundle_add_str(camera, "CALLER", "message");
	bundle_add_str(camera, "RESOLUTION", "VGA");
	attach_panel_add_content_category(__attachPanel, ATTACH_PANEL_CONTENT_CATEGORY_IMAGE, room);
	attach_panel_add_content_category(__attachPanel, ATTACH_PANEL_CONTENT_CATEGORY_CAMERA, camera);
	bundle_free(room);
	bundle_free(camera);
	attach_panel_set_result_cb(__attachPanel, __attachPanelResultCb, this);
	attach_panel_show(__attachPanel);
}

void MemoEditView::__destroyAttachPanel()
{
	if (!__attachPanel) {
		MEMO_LOGI("attachPanel is NULL");
		return;
	}
	attach_panel_hide(__attachPanel);
	attach_panel_remove_content_category(__attachPanel, ATTACH_PANEL_CONTENT_CATEGORY_IMAGE);
	attach_panel_remove_content_category(__attachPanel, ATTACH_PANEL_CONTENT_CATEGORY_CAMERA);
	attach_panel_unset_result_cb(__attachPanel);
	attach_panel_destroy(__attachPanel);
	__attachPanel = nullptr;
}

bool MemoEditView::__isAttachPanelOpened()
{
	bool visible = false;
	if (!__attachPanel || attach_panel_get_visibility(__attachPanel, &visible) != ATTACH_PANEL_ERROR_NONE)
		return false;
	return visible;
}

void MemoEditView::__attachPanelResultCb(attach_panel_h panel, attach_panel_content_category_e category,
                                         app_control_h result, app_control_result_e resultCode, void *data)
{
	(void)category;
	(void)resultCode;
	MemoEditView *self = static_cast<MemoEditView *>(data);
	if (!self) {
		MEMO_LOGE("self is NULL");
		attach_panel_hide(panel);
		attach_panel_unset_result_cb(panel);
		attach_panel_destroy(panel);
		return;
	}
	if (self->__attachResult)
		app_control_destroy(self->__attachResult);
	self->__attachResult = nullptr;
	app_control_clone(&self->__attachResult, result);
	if (self->__scroller)
		uxt_scroller_set_auto_scroll_enabled(self->__scroller, EINA_FALSE);
	elm_config_focus_autoscroll_mode_set(ELM_FOCUS_AUTOSCROLL_MODE_BRING_IN);
	self->__showProcessingPopup();
	WUiTimer::addTimer(
	    WORKER_DELAY,
	    [self](void *) {
		    // The worker owns the result and the copies until its end.
		    MemoEditViewImageJob *job = new MemoEditViewImageJob();
		    job->view = self;
		    job->result = self->__attachResult;
		    self->__attachResult = nullptr;
		    job->mediaPath = self->__mediaPath ? self->__mediaPath : "";
		    self->__imageJobs = eina_list_append(self->__imageJobs, job);
		    Ecore_Thread *thread = ecore_thread_run(__attachPanelThreadStartCb, __attachPanelThreadEndCb,
		                                            __attachPanelThreadCancelCb, job);
		    if (thread && eina_list_data_find(self->__imageJobs, job)) {
			    job->thread = thread;
			    self->__threadHandle = thread;
		    }
		    return false;
	    },
	    nullptr, self->getEvasObj());
}

void MemoEditView::__attachPanelThreadStartCb(void *data, Ecore_Thread *thread)
{
	(void)thread;
	MemoEditViewImageJob *job = static_cast<MemoEditViewImageJob *>(data);
	if (!job) {
		MEMO_LOGE("data is null");
		return;
	}
	if (!job->result) {
		MEMO_LOGE("Resul app control is null");
		return;
	}
	char **paths = nullptr;
	int count = 0;
	app_control_get_extra_data_array(job->result, APP_CONTROL_DATA_PATH, &paths, &count);
	ecore_file_mkpath(job->mediaPath.c_str());
	bool refused = false;
	for (int i = 0; i < count; i++) {
		int width = 0, height = 0, error = 0;
		float scale = 1.0f;
		const bool shrink = MemoUtil::getInsertImageSize(paths[i], &width, &height, &error, &scale);
		if (error != 0) {
			MEMO_LOGE("This file can not insert to entry.");
			refused = true;
		} else {
			char *uuid = nullptr;
			MemoUtil::createUUIDN(&uuid);
			std::string copy = job->mediaPath + (uuid ? uuid : "");
			free(uuid);
			const char *dot = strrchr(paths[i], '.');
			if (dot)
				copy += dot;
			ecore_file_cp(paths[i], copy.c_str());
			if (shrink)
				memoEditViewShrinkPicture(copy, width, height, scale);
			job->copies = eina_list_append(job->copies, strdup(copy.c_str()));
		}
		free(paths[i]);
	}
	free(paths);
	app_control_destroy(job->result);
	job->result = nullptr;
	// Posted from here: the toast finds its way to the main loop.
	if (refused)
		notification_status_message_post(i18n_get_text("IDS_MEMO_TPOP_RESOLUTION_NOT_SUPPORTED_BY_MEMO"));
}

void MemoEditView::__attachPanelThreadEndCb(void *data, Ecore_Thread *thread)
{
	(void)thread;
	MemoEditViewImageJob *job = static_cast<MemoEditViewImageJob *>(data);
	MemoEditView *self = __endImageJob(job);
	if (!self) {
		MEMO_LOGE("self is NULL");
		return;
	}
	void *path = nullptr;
	EINA_LIST_FREE(self->__attachedPaths, path)
	free(path);
	self->__attachedPaths = job->copies;
	job->copies = nullptr;
	delete job;
	if (self->__boxControl && self->__attachedPaths)
		self->__boxControl->insertImages(self->__attachedPaths);
	EINA_LIST_FREE(self->__attachedPaths, path)
	free(path);
	self->__afterPicturesIn();
	WUiTimer::addTimer(
	    AFTER_INSERT_DELAY,
	    [self](void *) {
		    if (self->__attachPanel) {
			    bundle *room = self->__attachRoomBundleN();
			    attach_panel_set_extra_data(self->__attachPanel, ATTACH_PANEL_CONTENT_CATEGORY_IMAGE, room);
			    bundle_free(room);
		    }
		    return false;
	    },
	    nullptr, self->getEvasObj());
}

void MemoEditView::__attachPanelThreadCancelCb(void *data, Ecore_Thread *thread)
{
	__imgProcessThreadCancelCb(data, thread);
}
