// The edit view's life: construction in its mode, the page layout, the steps after the push, teardown, and
// the operations other parts of the app call.
#include "View/MemoEditView.h"

#include <cstdlib>
#include <cstring>
#include <string>

#include <app_common.h>

#include <Ecore_File.h>
#include <efl_extension.h>

#include <WUiTimer.h>

#include "Box/MemoBoxItem.h"
#include "DataBase/MemoDbMgr.h"
#include "DataBase/MemoDocInfo.h"
#include "MemoLog.h"
#include "Model/MemoBroadCaster.h"
#include "Util/MemoUtil.h"
#include "MemoViewParts.h"

using app_assist::WUiTimer;

static const char *const EDIT_VIEW_GROUP = "edit_view";
static const int MEDIA_PATH_MAX = 1024;

static const int PALETTE[MemoEditView::PALETTE_SIZE][4] = {
    {228, 235, 235, 255}, {194, 194, 194, 255}, {250, 227, 137, 255}, {145, 224, 242, 255},
    {197, 230, 92, 255},  {255, 130, 218, 255}, {192, 121, 242, 255},
};

MemoEditView::MemoEditView(MemoDocInfo *info, bool external, bool immediateLayout)
    : __boxControl(nullptr), __player(nullptr), __scroller(nullptr), __info(info), __recorder(nullptr),
      __isPlayerDeleted(0), __isRecorderDeleted(0), __isNewHidden(0), __UUID(nullptr), __vrUUID(nullptr),
      __mediaPath(nullptr), __thumbPath(nullptr), __displayContent(nullptr), __mode(MODE_NEW), __cancelBtn(nullptr),
      __doneBtn(nullptr), __audioBtn(nullptr), __colorSelector(nullptr), __bgObject(nullptr),
      __processingPopup(nullptr), __imagePath(nullptr), __imageWidth(0), __imageHeight(0), __imageScale(1.0f),
      __isHiddenMode(0), __threadHandle(nullptr), __imageJobs(nullptr), __isPortrait(1), __callHandle(nullptr),
      __canSave(true), __isLaunching(false), __viewerCopyPath(nullptr), __viewerPopup(nullptr), __downX(0), __downY(0),
      __colorIndex(0), __isImmediateLayout(immediateLayout), __attachPanel(nullptr), __attachResult(nullptr),
      __attachedPaths(nullptr), __isAppPaused(false), __isDiscarded(false), __saveFailed(false)
{
	memcpy(__palette, PALETTE, sizeof(__palette));
	if (info) {
		// A memo with a record always opens read only, whoever asked.
		__mode = MODE_VIEW;
		__displayContent = info->getDisplayContent();
	} else {
		__mode = external ? MODE_NEW_EXTERNAL : MODE_NEW;
	}
}

MemoEditView::~MemoEditView()
{
	free(__UUID);
	free(__mediaPath);
	free(__vrUUID);
	free(__thumbPath);
	free(__imagePath);
	free(__viewerCopyPath);
	if (__processingPopup)
		evas_object_del(__processingPopup);
	__cancelImageJobs();
	// The copies shown by the image viewer.
	char *sharedPath = app_get_shared_data_path();
	if (sharedPath) {
		std::string viewDir = std::string(sharedPath) + "view/";
		if (ecore_file_is_dir(viewDir.c_str()))
			ecore_file_recursive_rm(viewDir.c_str());
		free(sharedPath);
	}
	__destroyAttachPanel();
	if (__attachResult)
		app_control_destroy(__attachResult);
	void *path = nullptr;
	EINA_LIST_FREE(__attachedPaths, path)
	free(path);
}

const char *MemoEditView::getClassName() const
{
	return "MemoEditView";
}

Evas_Object *MemoEditView::onCreateView(Evas_Object *parent, void *param)
{
	(void)param;
	if (!parent) {
		MEMO_LOGE("parent object is NULL");
		return nullptr;
	}
	Evas_Object *layout = nullptr;
	if (!memoViewPageLayoutAdd(parent, EDIT_VIEW_GROUP, &layout))
		MEMO_LOGE("group %s not found", EDIT_VIEW_GROUP);
	if (__mode == MODE_VIEW) {
		elm_object_signal_emit(layout, "change,view", "elm");
		char *time = __getTimeTextN();
		elm_object_part_text_set(layout, "time", time);
		free(time);
	} else {
		elm_object_signal_emit(layout, "change,edit", "elm");
	}
	eext_object_event_callback_add(layout, EEXT_CALLBACK_MORE, __moreBtnCb, this);
	eext_object_event_callback_add(layout, EEXT_CALLBACK_BACK, __backBtnCb, this);
	evas_object_show(layout);
	return layout;
}

void MemoEditView::onPushed(Elm_Object_Item *naviItem)
{
	(void)naviItem;
	Evas_Object *layout = getEvasObj();
	__updateRotationSignal();
	MemoBroadCaster::getInstance().addListener([this](const char *key, void *) { __onBroadcast(key); }, layout);

	char mediaPath[MEDIA_PATH_MAX] = {0};
	if (!__info) {
		if (__mode != MODE_NEW && __mode != MODE_NEW_EXTERNAL) {
			MEMO_LOGE("INFO is NULL");
			return;
		}
		MemoUtil::createUUIDN(&__UUID);
	} else {
		__UUID = strdup(__info->getMemoUUID());
	}
	snprintf(mediaPath, sizeof(mediaPath), "%smedia/%s/", MemoUtil::getDataPath(), __UUID ? __UUID : "");
	__mediaPath = strdup(mediaPath);
	if (!ecore_file_is_dir(__mediaPath))
		ecore_file_mkpath(__mediaPath);
	__createContentsLayout(layout);

	if (__info) {
		const char *vrUUID = __info->getVrfileUUID();
		if (vrUUID && *vrUUID) {
			__vrUUID = strdup(vrUUID);
			__createPlayer(false);
		}
		// The layout is built again once the page has its size, and the baseline that later tells a
		// change is taken from that build, so that an untouched memo reads as unchanged.
		if (__isImmediateLayout) {
			__createContentsLayout(layout);
			if (__boxControl)
				WUiTimer::addIdler(
				    [this](void *) {
					    __takeBaseline();
					    return false;
				    },
				    nullptr, layout);
		} else {
			WUiTimer::addIdler(
			    [this, layout](void *) {
				    __createContentsLayout(layout);
				    if (__boxControl)
					    WUiTimer::addIdler(
					        [this](void *) {
						        __takeBaseline();
						        return false;
					        },
					        nullptr, layout);
				    return false;
			    },
			    nullptr, layout);
		}
	}

	__createTitleBar();
	__registerCallStatus();
	if (MemoUtil::isRecorderBusy() || MemoUtil::isPowerSavingMode())
		__updateAudioBtnStatus(false);
}

void MemoEditView::onDestroy()
{
	__releaseOutsideObjects();
	if (__boxControl) {
		__boxControl->destroy();
		__boxControl = nullptr;
	}
	if (__recorder)
		__deleteRecorder();
	__destroyPlayer();
	if (__callHandle) {
		cm_deinit(__callHandle);
		__callHandle = nullptr;
	}
}

void MemoEditView::setHiddenMode(int isHiddenMode)
{
	__isHiddenMode = isHiddenMode;
}

MemoDocInfo *MemoEditView::getCurrentDocInfo()
{
	if (!__info)
		MEMO_LOGI("Doc info is NULL");
	return __info;
}

bool MemoEditView::insertTextToBody(const char *text)
{
	MemoBoxItem *item = __boxControl ? __boxControl->getFocusedItem() : nullptr;
	if (item)
		item->insertText(text);
	else
		MEMO_LOGE("no body item to take the text");
	return true;
}

bool MemoEditView::insertTextToTitle(const char *text)
{
	MemoBoxItem *item = __boxControl ? __boxControl->getTitleItem() : nullptr;
	if (item)
		item->insertText(text);
	else
		MEMO_LOGE("no title item to take the text");
	return true;
}
