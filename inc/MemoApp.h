#ifndef INC_MEMOAPP_H
#define INC_MEMOAPP_H

#include <app.h>
#include <uxt_theme.h>
#include <vconf.h>

#include <WApp.h>
#include <WAppEventHandler.h>

namespace app_assist
{
class WContentViewController;
class WNaviframeController;
} // namespace app_assist

class MemoDocInfo;

// 1 while the window stands in portrait, 0 in landscape. Written only by MemoApp on rotation; read by every
// view that lays itself out by orientation.
extern unsigned char gIsPortrait;

// The process: owns the window, the naviframe, the theme tables and the watches on the world outside, and
// turns what the platform and the sync service report into keys on MemoBroadCaster. It holds no memos.
// main builds one on its stack and calls start().
class MemoApp : public app_assist::WApp
{
public:
	MemoApp();
	// Closes the database, drops the record of the last "widget_open" and the popup monitor, then the
	// event registrations.
	~MemoApp() override;

	// Prepares the preference store (defaults on first run), the watches, the database, the window with its
	// naviframe, the theme tables and the theme extension. Pushes no view. Always returns true: failures are
	// logged by the parts that fail and do not stop the launch.
	bool onCreate() override;
	// Releases the theme tables, the bus and the vconf and rotation watches. Preference callbacks stay.
	void onTerminate() override;
	// Emits "broadcast,memo,app,pause".
	void onPause() override;
	// Emits "broadcast,memo,app,resume", then refreshes a list or search view on top.
	void onResume() override;
	// A launch request. The request belongs to the platform.
	void onAppControl(app_control_s *request, bool firstLaunch) override;

	// Theme or font change: sets both tables again. data is the MemoApp; null logs "data is NULL".
	static void __themeChangedCb(void *eventInfo, void *data);

private:
	MemoApp(const MemoApp &) = delete;
	MemoApp &operator=(const MemoApp &) = delete;

	// Loads and sets the colour and font tables once; a second call logs that they exist.
	void __changeableTableCreate();
	void __setBaseLayout(const char *edjPath);
	app_assist::WNaviframeController *__getNaviframe() const;
	app_assist::WContentViewController *__getTopView() const;
	void __saveOpenEditor();
	// ---- Launch requests (MemoAppControl.cpp, MemoAppShare.cpp) ----
	// The one page the process begins with, for the first launch request.
	void __pushFirstView(app_control_s *request, const char *operation);
	// The memo list; with pick true it runs in pick mode and answers the request.
	void __pushListView(bool pick, app_control_s *request);
	// What a share request brings goes into the new memo on top: subject, text, a text file or a picture.
	void __fillSharedMemo(app_control_s *request, const char *operation);
	// Text for the quick memo: into the quick memo open in the editor, else into the store; then the reply.
	void __addQuickMemoText(app_control_s *request);
	// Answers a quick memo request with the result (an app_control_result_e).
	void __replyToQuickMemo(app_control_s *request, int result);

	static void __bindTextDomains();
	static char *__getResourcePathN(const char *resourceId);

	static void __languageChangedCb(app_event_info_h eventInfo, void *data);
	static void __orientationChangedCb(app_event_info_h eventInfo, void *data);
	static void __timeFormatChangedCb(keynode_t *node, void *data);
	static void __rotationChangedCb(void *data, Evas_Object *obj, void *eventInfo);
	static void __memoSvcChangedCb(const char *key, void *data);
	static void __cloudTriggeringChangedCb(const char *key, void *data);

	app_assist::WAppEventHandler __languageEventHandler;
	app_assist::WAppEventHandler __regionEventHandler; // never registered
	app_assist::WAppEventHandler __orientationEventHandler;
	Uxt_Theme_Color_Table *__colorTable;
	Uxt_Theme_Font_Table *__fontTable;
	MemoDocInfo *__openedInfo; // the record opened by "widget_open"
};

#endif
