// Pictures brought into the edit view: the insert popup with its gallery and camera cells, the replies of
// those apps, pictures handed in at launch, and the workers that shrink large pictures off the main loop.
#include "View/MemoEditView.h"

#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <string>

#include <Ecore_File.h>
#include <WPopupController.h>
#include <WUiTimer.h>
#include <app_i18n.h>
#include <app_manager.h>
#include <notification.h>
#include <uxt_scroller.h>

#include "MemoEditViewImageJob.h"
#include "MemoLog.h"
#include "Model/MemoPopupMonitor.h"
#include "Util/MemoUtil.h"

using app_assist::WPopupController;
using app_assist::WUiTimer;
using app_assist::WViewControllerWeakPtr;

// The gallery is launched by this id; the cells show the icons of the apps the device presents for it.
static const char *const GALLERY_APP_ID = "tizen.gallery";
static const char *const GALLERY_ICON_APP_ID = "com.veltron.gallery-lite";
static const char *const CAMERA_ICON_APP_ID = "com.veltron.camera-app-lite";
static const int IMAGE_LIMIT = 10;
static const int LIMIT_TEXT_SIZE = 200;
static const int INSERT_POPUP_HEIGHT = 222;
// A launched app gets this long before the popup goes and another launch may start.
static const double LAUNCH_GUARD = 1.0;
// The page follows the focused entry smoothly while a picture comes in, and as before a moment later.
static const double AUTOSCROLL_RESET_DELAY = 1.0;

void memoEditViewShrinkPicture(const std::string &path, int width, int height, float scale)
{
	const int orient = MemoUtil::getOrient(path.c_str());
	if (eina_str_has_extension(path.c_str(), ".jpg"))
		MemoUtil::resizeImageJpg(path.c_str(), path.c_str(), width, height, scale);
	else if (!eina_str_has_extension(path.c_str(), ".png") ||
	         !MemoUtil::resizeImagePng(path.c_str(), path.c_str(), width, height))
		MemoUtil::resizeImage(path.c_str(), path.c_str(), width, height, 1);
	MemoUtil::rotateImage(path.c_str(), orient);
}

void MemoEditView::__postImageLimitMessage()
{
	MEMO_LOGI("Maximum number of images(10) reached.");
	char text[LIMIT_TEXT_SIZE] = {0};
	snprintf(text, sizeof(text), i18n_get_text("IDS_MEMO_TPOP_CANT_INSERT_MORE_THAN_PD_IMAGES"), IMAGE_LIMIT);
	notification_status_message_post(text);
}

int MemoEditView::__getImageCount()
{
	return __boxControl ? static_cast<int>(eina_list_count(__boxControl->getImageList())) : 0;
}

void MemoEditView::__imageBtnCb()
{
	if (!MemoUtil::getMemorySpaceStatusGet()) {
		__createStorageFullPopup();
		return;
	}
	if (!__boxControl) {
		MEMO_LOGE("__boxControl is NULL");
		return;
	}
	if (__getImageCount() >= IMAGE_LIMIT) {
		__postImageLimitMessage();
		return;
	}
	__createInsertPopup();
}

Evas_Object *MemoEditView::__getAppIcon(const char *appId, Evas_Object *parent)
{
	app_info_h info = nullptr;
	int ret = app_manager_get_app_info(appId, &info);
	if (ret != APP_MANAGER_ERROR_NONE) {
		MEMO_LOGE("app_manager_get_app_info err code:%d", ret);
		return nullptr;
	}
	char *path = nullptr;
	ret = app_info_get_icon(info, &path);
	app_info_destroy(info);
	if (ret != APP_MANAGER_ERROR_NONE) {
		MEMO_LOGE("app_info_get_icon err code:%d", ret);
		return nullptr;
	}
	Evas_Object *icon = elm_image_add(parent);
	elm_image_file_set(icon, path, nullptr);
	free(path);
	return icon;
}

void MemoEditView::__createInsertPopup()
{
	WPopupController *popup = new WPopupController();
	popup->setTextTranslatable("memo-sub");
	popup->setTitle("IDS_MEMO_OPT_INSERT_IMAGE_ABB");
	popup->setOnAddProperties([this](Evas_Object *obj) {
		elm_object_style_set(obj, "memo");
		Evas_Object *box = elm_box_add(obj);
		elm_box_horizontal_set(box, EINA_TRUE);
		struct Cell {
			const char *iconAppId;
			const char *text;
			Edje_Signal_Cb cb;
		};
		for (const Cell &cell : {Cell{GALLERY_ICON_APP_ID, "IDS_MEMO_OPT_FROM_GALLERY_ABB2", __onGalleryClickedCb},
		                         Cell{CAMERA_ICON_APP_ID, "IDS_MEMO_OPT_TAKE_PICTURE_ABB", __onCameraClickedCb}}) {
			Evas_Object *layout = elm_layout_add(box);
			elm_layout_file_set(layout, MemoUtil::getEdjePath(), "insert_app_layout");
			evas_object_size_hint_weight_set(layout, EVAS_HINT_EXPAND, EVAS_HINT_EXPAND);
			evas_object_size_hint_align_set(layout, EVAS_HINT_FILL, EVAS_HINT_FILL);
			Evas_Object *icon = __getAppIcon(cell.iconAppId, layout);
			if (icon)
				elm_object_part_content_set(layout, "app_icon", icon);
			elm_object_domain_translatable_part_text_set(layout, "app_text", "memo-sub", cell.text);
			elm_object_signal_callback_add(layout, "mouse,up,1", "touch_rect", cell.cb, this);
			evas_object_show(layout);
			elm_box_pack_end(box, layout);
		}
		evas_object_size_hint_min_set(
		    box, 0, static_cast<Evas_Coord>(INSERT_POPUP_HEIGHT * elm_config_scale_get() / elm_app_base_scale_get()));
		evas_object_show(box);
		elm_object_content_set(obj, box);
		evas_object_smart_callback_add(obj, "block,clicked", __onPopupBlockClickedCb, this);
	});
	MemoPopupMonitor::getInstance()->addPopup(popup);
	attachPopup(popup);
}

void MemoEditView::__onPopupBlockClickedCb(void *data, Evas_Object *obj, void *eventInfo)
{
	(void)obj;
	(void)eventInfo;
	MemoEditView *self = static_cast<MemoEditView *>(data);
	if (!self) {
		MEMO_LOGE("self is null.");
		return;
	}
	self->destroyPopup();
}

void MemoEditView::__onGalleryClickedCb(void *data, Evas_Object *obj, const char *emission, const char *source)
{
	(void)obj;
	(void)emission;
	(void)source;
	if (data)
		static_cast<MemoEditView *>(data)->__launchPicker(false);
}

void MemoEditView::__onCameraClickedCb(void *data, Evas_Object *obj, const char *emission, const char *source)
{
	(void)obj;
	(void)emission;
	(void)source;
	if (data)
		static_cast<MemoEditView *>(data)->__launchPicker(true);
}

void MemoEditView::__launchPicker(bool camera)
{
	// A second touch while an app comes up is lost.
	if (__isLaunching)
		return;
	MemoUtil::playTapFeedback();
	__isLaunching = true;
	app_control_h request = nullptr;
	if (app_control_create(&request) != APP_CONTROL_ERROR_NONE) {
		// The guard stays up: no launch from this page any more.
		MEMO_LOGE("app_control_create failed.");
		return;
	}
	app_control_set_launch_mode(request, APP_CONTROL_LAUNCH_MODE_GROUP);
	if (camera) {
		// Any camera that makes content.
		app_control_set_operation(request, APP_CONTROL_OPERATION_CREATE_CONTENT);
		app_control_set_mime(request, "image/jpg");
		app_control_add_extra_data(request, "CALLER", "message");
		app_control_add_extra_data(request, "RESOLUTION", "VGA");
	} else {
		app_control_set_app_id(request, GALLERY_APP_ID);
		app_control_set_operation(request, APP_CONTROL_OPERATION_PICK);
		app_control_set_mime(request, "image/*");
	}
	// The reply may come after the page has gone: it finds the page through a weak reference.
	WViewControllerWeakPtr *page = new WViewControllerWeakPtr(getWeakPtr());
	const int ret = app_control_send_launch_request(request, __galleryCb, page);
	if (ret != APP_CONTROL_ERROR_NONE) {
		MEMO_LOGE("app_control_send_launch_request failed (%d)", ret);
		delete page;
	}
	app_control_destroy(request);

	if (__boxControl)
		__boxControl->suspendKeypad();
	WUiTimer::addTimer(
	    LAUNCH_GUARD,
	    [this](void *) {
		    destroyPopup();
		    if (__boxControl)
			    __boxControl->resumeKeypad();
		    __isLaunching = false;
		    return false;
	    },
	    nullptr, getEvasObj());
}

void MemoEditView::__galleryCb(app_control_h request, app_control_h reply, app_control_result_e result, void *data)
{
	(void)request;
	(void)result;
	WViewControllerWeakPtr *page = static_cast<WViewControllerWeakPtr *>(data);
	MemoEditView *self = page ? dynamic_cast<MemoEditView *>(page->lock().get()) : nullptr;
	delete page;
	if (!self) {
		MEMO_LOGE("self is NULL");
		return;
	}
	elm_config_focus_autoscroll_mode_set(ELM_FOCUS_AUTOSCROLL_MODE_BRING_IN);
	char **selected = nullptr;
	int count = 0;
	if (app_control_get_extra_data_array(reply, APP_CONTROL_DATA_SELECTED, &selected, &count) !=
	        APP_CONTROL_ERROR_NONE ||
	    count <= 0) {
		free(selected);
		return;
	}
	// Every picture of one reply is copied to the same name; the launches ask for one picture.
	const std::string destination = self->__newImagePath(selected[0]);
	if (self->__mediaPath)
		ecore_file_mkpath(self->__mediaPath);
	for (int i = 0; i < count; i++) {
		self->__takePicture(selected[i], destination.c_str());
		free(selected[i]);
	}
	free(selected);
}

std::string MemoEditView::__newImagePath(const char *source)
{
	char *uuid = nullptr;
	MemoUtil::createUUIDN(&uuid);
	std::string path =
	    std::string(MemoUtil::getDataPath()) + "media/" + (__UUID ? __UUID : "") + "/" + (uuid ? uuid : "");
	free(uuid);
	// The extension with its dot; a source name without a dot gives none.
	const char *dot = source ? strrchr(source, '.') : nullptr;
	if (dot)
		path += dot;
	return path;
}

bool MemoEditView::insertImage(const char *path)
{
	const std::string destination = __newImagePath(path);
	if (__mediaPath)
		ecore_file_mkpath(__mediaPath);
	__takePicture(path, destination.c_str());
	return true;
}

bool MemoEditView::__takePicture(const char *source, const char *destination)
{
	int width = 0, height = 0, error = 0;
	float scale = 1.0f;
	const bool shrink = MemoUtil::getInsertImageSize(source, &width, &height, &error, &scale);
	if (error != 0) {
		MEMO_LOGE("This file can not insert to entry.");
		notification_status_message_post(i18n_get_text("IDS_MEMO_TPOP_RESOLUTION_NOT_SUPPORTED_BY_MEMO"));
		__focusEntry(false);
		return false;
	}
	__imageWidth = width;
	__imageHeight = height;
	__imageScale = scale;
	ecore_file_cp(source, destination);
	if (!__boxControl) {
		MEMO_LOGE("__boxControl is NULL");
		return false;
	}
	if (!shrink) {
		// Small pictures come in at once, with no worker and no popup.
		__boxControl->insertImage(destination);
		__focusEntry(false);
		if (__getImageCount() >= IMAGE_LIMIT)
			__postImageLimitMessage();
		WUiTimer::addTimer(
		    AUTOSCROLL_RESET_DELAY,
		    [](void *) {
			    elm_config_focus_autoscroll_mode_set(ELM_FOCUS_AUTOSCROLL_MODE_SHOW);
			    return false;
		    },
		    nullptr, getEvasObj());
		return true;
	}
	free(__imagePath);
	__imagePath = strdup(destination);
	__showProcessingPopup();
	__boxControl->suspendKeypad();
	__startImageJob();
	return true;
}

void MemoEditView::__startImageJob()
{
	MemoEditViewImageJob *job = new MemoEditViewImageJob();
	job->view = this;
	job->path = __imagePath ? __imagePath : "";
	job->width = __imageWidth;
	job->height = __imageHeight;
	job->scale = __imageScale;
	__imageJobs = eina_list_append(__imageJobs, job);
	Ecore_Thread *thread =
	    ecore_thread_run(__imgProcessThreadStartCb, __imgProcessThreadEndCb, __imgProcessThreadCancelCb, job);
	// Without a thread the job has already run and ended.
	if (thread && eina_list_data_find(__imageJobs, job)) {
		job->thread = thread;
		__threadHandle = thread;
	}
}

void MemoEditView::__imgProcessThreadStartCb(void *data, Ecore_Thread *thread)
{
	(void)thread;
	MemoEditViewImageJob *job = static_cast<MemoEditViewImageJob *>(data);
	if (!job) {
		MEMO_LOGE("self is NULL");
		return;
	}
	memoEditViewShrinkPicture(job->path, job->width, job->height, job->scale);
}

MemoEditView *MemoEditView::__endImageJob(MemoEditViewImageJob *job)
{
	MemoEditView *self = job ? job->view : nullptr;
	if (!self) {
		delete job;
		return nullptr;
	}
	self->__imageJobs = eina_list_remove(self->__imageJobs, job);
	if (self->__threadHandle == job->thread)
		self->__threadHandle = nullptr;
	if (self->__boxControl)
		self->__boxControl->resumeKeypad();
	if (self->__processingPopup)
		evas_object_del(self->__processingPopup);
	return self;
}

void MemoEditView::__imgProcessThreadEndCb(void *data, Ecore_Thread *thread)
{
	(void)thread;
	MemoEditViewImageJob *job = static_cast<MemoEditViewImageJob *>(data);
	MemoEditView *self = __endImageJob(job);
	if (!self)
		return;
	if (self->__boxControl)
		self->__boxControl->insertImage(job->path.c_str());
	free(self->__imagePath);
	self->__imagePath = nullptr;
	self->__imageWidth = 0;
	self->__imageHeight = 0;
	delete job;
	if (self->__getImageCount() >= IMAGE_LIMIT)
		__postImageLimitMessage();
	self->__afterPicturesIn();
}

void MemoEditView::__imgProcessThreadCancelCb(void *data, Ecore_Thread *thread)
{
	(void)thread;
	MemoEditViewImageJob *job = static_cast<MemoEditViewImageJob *>(data);
	if (job && job->view)
		job->view->__imageJobs = eina_list_remove(job->view->__imageJobs, job);
	delete job;
}

void MemoEditView::__afterPicturesIn()
{
	if (__scroller)
		uxt_scroller_set_auto_scroll_enabled(__scroller, EINA_TRUE);
	WUiTimer::addIdler(
	    [this](void *) {
		    __focusEntry(false);
		    return false;
	    },
	    nullptr, getEvasObj());
	WUiTimer::addTimer(
	    AUTOSCROLL_RESET_DELAY,
	    [](void *) {
		    elm_config_focus_autoscroll_mode_set(ELM_FOCUS_AUTOSCROLL_MODE_SHOW);
		    return false;
	    },
	    nullptr, getEvasObj());
}

void MemoEditView::__cancelImageJobs()
{
	void *data = nullptr;
	EINA_LIST_FREE(__imageJobs, data)
	{
		MemoEditViewImageJob *job = static_cast<MemoEditViewImageJob *>(data);
		// The job ends on its own, without the view.
		job->view = nullptr;
		if (job->thread)
			ecore_thread_cancel(job->thread);
	}
	__threadHandle = nullptr;
}
