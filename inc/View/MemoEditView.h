#ifndef INC_VIEW_MEMOEDITVIEW_H
#define INC_VIEW_MEMOEDITVIEW_H

#include <string>

#include <app_control.h>
#include <attach_panel.h>
#include <bundle.h>
#include <call-manager.h>

#include <Elementary.h>
#include <WContentViewController.h>

#include "Box/MemoBoxControl.h"

class MemoDocInfo;
class MemoFileInfo;
struct MemoEditViewImageJob;
class MemoPlayer;
class MemoRecorder;

// The screen on which a memo is read, written and changed: a page of the naviframe holding the memo's
// box control in a scroller over the memo's colour, with Cancel and Done in the title bar while editing.
// A memo with a record opens read only (MODE_VIEW); a tap under its text or on it turns it into an edit
// (MODE_UPDATE). A new memo starts in MODE_NEW, or MODE_NEW_EXTERNAL when another app asked for it.
//
// Files: MemoEditView.cpp (construction, push, teardown, public operations), MemoEditViewLayout.cpp (contents,
// title bar, taps, modes, box signals), MemoEditViewEvents.cpp (rotation, broadcasts, calls),
// MemoEditViewSave.cpp (change detection and the write), MemoEditViewFiles.cpp (file rows, thumbnail, media
// folder), MemoEditViewPopups.cpp (Cancel, back, discard, storage and delete popups), MemoEditViewMore.cpp
// (the more menu), MemoEditViewShare.cpp (the memo sent to other apps), MemoEditViewColor.cpp (colour
// selector), MemoEditViewImages.cpp (pictures from the gallery and camera, and handed in at launch),
// MemoEditViewViewer.cpp (a picture opened in the image viewer), MemoEditViewAttach.cpp (the attach panel),
// MemoEditViewVoice.cpp (the recorder and player panels).
class MemoEditView : public app_assist::WContentViewController
{
public:
	// `info` is not owned and may be null (a new memo). With a record the view reads it (MODE_VIEW) and
	// `external` is ignored; without one `external` picks MODE_NEW_EXTERNAL over MODE_NEW.
	// `immediateLayout` builds the contents a second time at once instead of on an idler.
	MemoEditView(MemoDocInfo *info, bool external, bool immediateLayout);

	const char *getClassName() const override;

protected:
	// The page layout (group "edit_view") with the more and back keys on it; null with "parent object is
	// NULL".
	Evas_Object *onCreateView(Evas_Object *parent, void *param) override;
	void onDestroy() override;

public:
	~MemoEditView() override;

	void onPushed(Elm_Object_Item *naviItem) override;

	// 1 when opened from the hidden memos.
	void setHiddenMode(int isHiddenMode);
	// The record the view was opened with (not owned); null with the info line "Doc info is NULL".
	MemoDocInfo *getCurrentDocInfo();
	// Inserts markup into the focused body item, or into the title item. Always true.
	bool insertTextToBody(const char *text);
	bool insertTextToTitle(const char *text);
	// A picture handed in by a launch request. Always true.
	bool insertImage(const char *path);
	// Whether the user chose Discard.
	bool isDiscarded() const { return __isDiscarded; }
	// The save at application exit: stops a recording and writes the memo, changed or not; nothing in
	// MODE_VIEW. A failed write is logged.
	void saveOnExit();

	// Rows of the memo colours, red, green, blue and alpha.
	static const int PALETTE_SIZE = 7;

private:
	// Tests reach what no user action starts (the attach panel) and what shows only for a moment (the
	// processing popup).
	friend struct MemoEditViewTestAccess;

	MemoEditView(const MemoEditView &) = delete;
	MemoEditView &operator=(const MemoEditView &) = delete;

	// ---- Layout and modes (MemoEditViewLayout.cpp) ----
	void __createContentsLayout(Evas_Object *parent);
	void __takeBaseline();
	void __onScrollerMouseUp(int x, int y);
	void __changeToUpdateMode();
	void __createTitleBar();
	void __updateDoneBtnStatus(bool enable);
	void __updateAudioBtnStatus(bool enable);
	void __onBoxSignal(const char *signal, void *data);
	void __showProcessingPopup();
	void __focusEntry(bool showKeypad);
	// The palette row equal to the four values, 0 when none is.
	int __findPaletteIndex(int red, int green, int blue, int alpha) const;
	static void __scrollerMouseDownCb(void *data, Evas *e, Evas_Object *obj, void *eventInfo);
	static void __scrollerMouseUpCb(void *data, Evas *e, Evas_Object *obj, void *eventInfo);
	static void __processingPopupDelCb(void *data, Evas *e, Evas_Object *obj, void *eventInfo);
	static void __titleBtnDelCb(void *data, Evas *e, Evas_Object *obj, void *eventInfo);
	// The title buttons and the processing popup may outlive the page: they lose their way back to it.
	void __releaseOutsideObjects();

	// ---- Rotation, broadcasts, calls (MemoEditViewEvents.cpp) ----
	void __updateRotationSignal();
	void __onBroadcast(const char *key);
	// New string: the record's date of change as the device writes dates; null without a record.
	char *__getTimeTextN();
	void __registerCallStatus();
	void __onCallStatusChanged(cm_call_status_e status);
	static void __callStatusCb(cm_call_status_e status, const char *number, void *data);

	// ---- Saving (MemoEditViewSave.cpp, MemoEditViewFiles.cpp) ----
	bool __isChanged();
	bool __isRecorderUpdated();
	static void __doneBtnCb(void *data, Evas_Object *obj, void *eventInfo);
	// Writes the memo. False only when the store refused the write (the editor then stays open).
	bool __saveMemo();
	bool __writeRecord(MemoDocInfo *record);
	void __onSaveFailed();
	// Adds the voice and image rows to `record` and tidies the media folder.
	void __collectFiles(MemoDocInfo *record, Eina_List *images, const char *title);
	bool __fillFileInfo(MemoFileInfo *file, const char *fileUUID, const char *mime, const char *path);
	void __refreshMediaFolder(Eina_List *images);
	bool __createThumbnail(const char *path, bool hasTitle);

	// ---- Leaving (MemoEditViewPopups.cpp) ----
	bool __isTop() const;
	void __popOutLater(bool removeMedia);
	static void __cancelBtnCb(void *data, Evas_Object *obj, void *eventInfo);
	static void __backBtnCb(void *data, Evas_Object *obj, void *eventInfo);
	void __createDiscardPopup();
	void __discard();
	void __createStorageFullPopup();
	void __createDeletePopup();
	static void __launchStorageSettings();

	// ---- More menu (MemoEditViewMore.cpp) ----
	static void __moreBtnCb(void *data, Evas_Object *obj, void *eventInfo);
	// `keypadWasOpen`: the keypad went down for the menu, so a recording needs not hold it back.
	void __createMoreMenu(bool keypadWasOpen);
	void __setHiddenState(bool hide);
	void __onRecordMenuItem(bool keypadWasOpen);
	bool __isKeypadOpen();

	// ---- Sharing (MemoEditViewShare.cpp) ----
	// The memo as text for other apps: title, body with "[  ]" / "[v]" check marks, no markup.
	std::string __getShareText();
	static bool __hasVisibleText(const std::string &text);
	// Copies of the memo's files under the shared data folder, one per file; the caller frees them.
	char **__getSharedCopiesN(int *count);
	void __shareMemo();

	// ---- Colour selector (MemoEditViewColor.cpp) ----
	void __createColorSelector();
	void __closeColorSelector(bool focus);
	static void __colorSelectedCb(void *data, Evas_Object *obj, void *eventInfo);

	// ---- Pictures from other apps (MemoEditViewImages.cpp) ----
	static void __postImageLimitMessage();
	int __getImageCount();
	void __imageBtnCb();
	void __createInsertPopup();
	static Evas_Object *__getAppIcon(const char *appId, Evas_Object *parent);
	static void __onGalleryClickedCb(void *data, Evas_Object *obj, const char *emission, const char *source);
	static void __onCameraClickedCb(void *data, Evas_Object *obj, const char *emission, const char *source);
	static void __onPopupBlockClickedCb(void *data, Evas_Object *obj, void *eventInfo);
	void __launchPicker(bool camera);
	static void __galleryCb(app_control_h request, app_control_h reply, app_control_result_e result, void *data);
	// Copies `source` to `destination` and puts it in the text, shrinking it on a worker first when it is
	// large. False when the picture is refused (told to the user).
	bool __takePicture(const char *source, const char *destination);
	// "<data>media/<memo>/<new uuid>" and the source's extension.
	std::string __newImagePath(const char *source);
	void __startImageJob();
	static void __imgProcessThreadStartCb(void *data, Ecore_Thread *thread);
	static void __imgProcessThreadEndCb(void *data, Ecore_Thread *thread);
	// A picture worker has ended: its view with the job out of its books, the keypad back and the processing
	// popup gone; null when the view has gone (the job is then freed).
	static MemoEditView *__endImageJob(MemoEditViewImageJob *job);
	static void __imgProcessThreadCancelCb(void *data, Ecore_Thread *thread);
	void __afterPicturesIn();
	// Cuts the workers loose: they end without the view.
	void __cancelImageJobs();

	// ---- Image viewer (MemoEditViewViewer.cpp) ----
	void __onImageSelected(const char *path);
	static void __imageViewerCb(app_control_h request, app_control_h reply, app_control_result_e result, void *data);

	// ---- Attach panel (MemoEditViewAttach.cpp) ----
	void __createAttachPanel();
	void __destroyAttachPanel();
	bool __isAttachPanelOpened();
	bundle *__attachRoomBundleN();
	static void __attachPanelResultCb(attach_panel_h panel, attach_panel_content_category_e category,
	                                  app_control_h result, app_control_result_e resultCode, void *data);
	static void __attachPanelThreadStartCb(void *data, Ecore_Thread *thread);
	static void __attachPanelThreadEndCb(void *data, Ecore_Thread *thread);
	static void __attachPanelThreadCancelCb(void *data, Ecore_Thread *thread);

	// ---- Voice (MemoEditViewVoice.cpp) ----
	// True while a recorder holds a recording handle: from its start until it is given up.
	bool __isRecording() const;
	// Done's stop of a recording: the recorder stops after 0.1 s; false when it stayed under one second and
	// is not kept.
	bool __stopRecording();
	// The voice panel is free: no live player, and no recorder or a finished one.
	bool __isVoicePanelFree() const;
	void __deleteRecorder();
	void __destroyPlayer();
	// The player of the stored voice file (`__vrUUID`), with its delete button or for reading.
	void __createPlayer(bool withDeleteButton);
	void __showPlayer(const char *path, bool withDeleteButton);
	void __closeVoicePanel();
	char *__getVrPathN(const char *uuid);
	// Opens the recorder panel.
	void __audioBtnCb();
	void __recorderActionCb(const char *signal, const char *data);
	void __playerActionCb(const char *signal, const char *data);
	void __onVoicePopup();

	MemoBoxControl *__boxControl;
	MemoPlayer *__player;
	Evas_Object *__scroller;
	MemoDocInfo *__info;
	MemoRecorder *__recorder;
	int __isPlayerDeleted;
	int __isRecorderDeleted;
	int __isNewHidden;
	char *__UUID;
	char *__vrUUID;
	char *__mediaPath;
	char *__thumbPath;
	const char *__displayContent;
	int __mode;
	Evas_Object *__cancelBtn;
	Evas_Object *__doneBtn;
	Evas_Object *__audioBtn; // never created: the more menu starts recordings
	Evas_Object *__colorSelector;
	Evas_Object *__bgObject;
	Evas_Object *__processingPopup;
	char *__imagePath;
	int __imageWidth;
	int __imageHeight;
	float __imageScale; // the shrink factor, a fraction
	int __isHiddenMode;
	Ecore_Thread *__threadHandle; // the last image worker ("__thread" is a compiler keyword)
	Eina_List *__imageJobs;       // the workers under way, cut loose from the view when it goes
	int __isPortrait;
	cm_client_h __callHandle;
	bool __canSave;
	bool __isLaunching;
	char *__viewerCopyPath;
	Evas_Object *__viewerPopup; // nothing sets it
	int __downX;
	int __downY;
	int __colorIndex;
	int __palette[PALETTE_SIZE][4];
	bool __isImmediateLayout;
	attach_panel_h __attachPanel; // no flow opens the attach panel
	app_control_h __attachResult;
	Eina_List *__attachedPaths;
	bool __isAppPaused;
	bool __isDiscarded;
	// A failed write was reported: the next save of a new memo checks whether its row exists after all.
	bool __saveFailed;
};

#endif
