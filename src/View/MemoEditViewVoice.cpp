// The edit view's voice panel: a recorder or a player in the part "recorder_contents", never both live, what
// the view does on each of their signals, and where the voice file lies.
#include "View/MemoEditView.h"

#include <cstdlib>
#include <cstring>
#include <string>

#include <Ecore_File.h>
#include <WUiTimer.h>
#include <app_common.h>

#include "Box/MemoBoxControl.h"
#include "Box/MemoBoxItem.h"
#include "DataBase/MemoDbMgr.h"
#include "MemoLog.h"
#include "Model/MemoPopupMonitor.h"
#include "Recorder/MemoPlayer.h"
#include "Recorder/MemoRecorder.h"

// What the player is given to show a stored memo for reading: only its being non-null counts.
static int VIEW_MODE_PLAYER = 1;

bool MemoEditView::__isRecording() const
{
	return __recorder && __recorder->hasRecorderHandle();
}

bool MemoEditView::__stopRecording()
{
	const bool enough = __recorder->isRecordedEnough();
	MemoRecorder::recorderStopCb(__recorder, nullptr, nullptr, nullptr);
	return enough;
}

bool MemoEditView::__isVoicePanelFree() const
{
	if (__player)
		return __isPlayerDeleted == 1;
	return !__recorder || __isRecorderDeleted == 1;
}

// Its listeners go with it.
void MemoEditView::__deleteRecorder()
{
	if (!__recorder) {
		MEMO_LOGE("Recorder is not NULL");
		return;
	}
	__recorder->destroy();
	__recorder = nullptr;
}

void MemoEditView::__destroyPlayer()
{
	if (!__player)
		return;
	__player->destroy();
	__player = nullptr;
}

// The player of the memo's stored voice file: for reading, or with its delete button in an edit.
void MemoEditView::__createPlayer(bool withDeleteButton)
{
	char *path = nullptr;
	MemoDbMgr *db = MemoDbMgr::getInstance();
	if (db && __vrUUID)
		db->getFilePathN(__vrUUID, &path);
	__showPlayer(path, withDeleteButton);
	free(path);
}

// What the desktop's media controls call the voice memo: its title, else the app's name.
static std::string mediaTitleOf(MemoBoxControl *boxControl)
{
	char *title = boxControl ? boxControl->getTitleTextN() : nullptr;
	if (!title)
		app_get_name(&title);
	std::string text = title ? title : "";
	free(title);
	return text;
}

void MemoEditView::__showPlayer(const char *path, bool withDeleteButton)
{
	MemoPlayer *player = new MemoPlayer(path);
	if (!player->create(getEvasObj(), withDeleteButton ? nullptr : &VIEW_MODE_PLAYER)) {
		player->destroy();
		return;
	}
	player->__signal.addListener([this](const char *signal, const char *data) { __playerActionCb(signal, data); },
	                             getEvasObj());
	player->setMediaTitle(mediaTitleOf(__boxControl).c_str());
	__player = player;
}

// The panel leaves the page; its object lives on until the recorder or player goes.
void MemoEditView::__closeVoicePanel()
{
	Evas_Object *panel = elm_object_part_content_unset(getEvasObj(), "recorder_contents");
	if (panel)
		evas_object_hide(panel);
	elm_object_signal_emit(getEvasObj(), "recorder,close", "elm");
}

char *MemoEditView::__getVrPathN(const char *uuid)
{
	if (!uuid || !__UUID || !__mediaPath) {
		MEMO_LOGE("input or __UUID is  NULL");
		return nullptr;
	}
	Eina_List *entries = ecore_file_ls(__mediaPath);
	if (!entries)
		return nullptr;
	const std::string wanted = std::string(uuid) + ".amr";
	std::string found;
	Eina_List *l = nullptr;
	void *data = nullptr;
	// The first pass matches an entry one byte longer than "<uuid>.amr" and takes the wanted name; an entry
	// equal to it does not match here.
	EINA_LIST_FOREACH(entries, l, data)
	{
		const char *name = static_cast<const char *>(data);
		const size_t nameLen = strlen(name);
		const size_t shorter = nameLen < wanted.size() ? nameLen : wanted.size();
		long result = memcmp(name, wanted.c_str(), shorter);
		if (result == 0)
			result = static_cast<long>(nameLen) - static_cast<long>(wanted.size());
		if (result == 1) {
			found = std::string(__mediaPath) + wanted;
			break;
		}
	}
	if (found.empty()) {
		EINA_LIST_FOREACH(entries, l, data)
		{
			const char *name = static_cast<const char *>(data);
			if (strstr(name, uuid)) {
				found = std::string(__mediaPath) + name;
				break;
			}
		}
	}
	EINA_LIST_FREE(entries, data)
	free(data);
	if (found.empty() || !ecore_file_exists(found.c_str()))
		return nullptr;
	return strdup(found.c_str());
}

void MemoEditView::__audioBtnCb()
{
	// A finished or given-up recorder makes way for the new one.
	if (__isRecorderDeleted == 1) {
		__isRecorderDeleted = 0;
		__deleteRecorder();
	}
	__updateAudioBtnStatus(false);
	if (__recorder)
		return;
	if (__player) {
		__destroyPlayer();
		__isPlayerDeleted = 0;
	}
	MemoRecorder *recorder = new MemoRecorder();
	if (!recorder->create(getEvasObj(), __UUID)) {
		recorder->destroy();
		return;
	}
	recorder->__signal.addListener([this](const char *signal, const char *data) { __recorderActionCb(signal, data); },
	                               getEvasObj());
	recorder->setMediaTitle(mediaTitleOf(__boxControl).c_str());
	__recorder = recorder;
	if (__colorSelector)
		elm_object_signal_emit(getEvasObj(), "show,colorselector,with,recorder", "elm");
	__updateRotationSignal();
}

// The keypad and the attach panel make way for a question of the voice panel.
void MemoEditView::__onVoicePopup()
{
	const bool keypadOpen = __isKeypadOpen();
	if (__isAttachPanelOpened())
		attach_panel_hide(__attachPanel);
	if (!keypadOpen || !__boxControl)
		return;
	for (MemoBoxItem *item : {__boxControl->getFocusedItem(), __boxControl->getTitleItem()}) {
		if (item && item->getEntry())
			elm_entry_input_panel_hide(item->getEntry());
	}
}

// Each signal is tested in turn.
void MemoEditView::__recorderActionCb(const char *signal, const char *data)
{
	if (!signal)
		return;
	if (!strcmp(signal, "recorder,start"))
		__updateDoneBtnStatus(true);
	if (!strcmp(signal, "recorder,stop")) {
		char *path = __getVrPathN(data);
		__closeVoicePanel();
		if (path && !__player) {
			__showPlayer(path, true);
			free(__vrUUID);
			__vrUUID = strdup(data);
			__isRecorderDeleted = 1;
		}
		free(path);
		if (MemoPopupMonitor::getInstance()->isPopupAlive())
			MemoPopupMonitor::getInstance()->getPopup()->destroy();
		__updateDoneBtnStatus(true);
	}
	if (!strcmp(signal, "recorder,delete")) {
		__closeVoicePanel();
		if (__recorder) {
			__isRecorderDeleted = 1;
			__updateAudioBtnStatus(true);
		}
		if (__boxControl)
			__boxControl->onEntryChanged(nullptr, nullptr);
		if (__colorSelector)
			elm_object_signal_emit(getEvasObj(), "show,colorselector,no,recorder", "elm");
		else if (!__isAppPaused)
			__focusEntry(true);
	}
	if (!strcmp(signal, "recorder,dicardPopUp"))
		__onVoicePopup();
}

void MemoEditView::__playerActionCb(const char *signal, const char *data)
{
	(void)data;
	if (!signal)
		return;
	if (!strcmp(signal, "player,delete")) {
		__closeVoicePanel();
		if (__player)
			__isPlayerDeleted = 1;
		if (__recorder)
			__deleteRecorder();
		// The file stays until the save tidies the media folder.
		free(__vrUUID);
		__vrUUID = nullptr;
		__updateAudioBtnStatus(true);
		if (__boxControl)
			__boxControl->onEntryChanged(nullptr, nullptr);
		if (__colorSelector)
			elm_object_signal_emit(getEvasObj(), "show,colorselector,no,recorder", "elm");
		else
			__focusEntry(true);
	} else if (!strcmp(signal, "player,dragStart")) {
		if (__isKeypadOpen() && __boxControl)
			__boxControl->suspendKeypad();
	} else if (!strcmp(signal, "player,dragStop")) {
		if (__isKeypadOpen())
			app_assist::WUiTimer::addIdler(
			    [this](void *) {
				    if (__boxControl)
					    __boxControl->resumeKeypad();
				    __focusEntry(false);
				    return false;
			    },
			    nullptr, getEvasObj());
	} else if (!strcmp(signal, "player,deletePopUp")) {
		__onVoicePopup();
	}
}
