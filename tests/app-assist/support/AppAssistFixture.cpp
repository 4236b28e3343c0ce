// Shared UI scaffolding of the framework tests.
#include "AppAssistFixture.h"

#include "TestEnv.h"

namespace aa_test
{

static void initElementaryOnce()
{
	static bool ready = false;
	if (ready)
		return;
	static char arg0[] = "app-assist-test";
	static char *argv[] = {arg0, nullptr};
	elm_init(1, argv);
	ready = true;
}

void UiTest::SetUp()
{
	initElementaryOnce();
	window = new app_assist::WWindowController("app-assist-test", ELM_WIN_BASIC);
	ASSERT_NE(window->getEvasObj(), nullptr);
	naviframe = new app_assist::WNaviframeController();
	ASSERT_TRUE(window->attachBaseViewController(naviframe));
	runFor(0.05);
}

void UiTest::TearDown()
{
	delete window;
	window = nullptr;
	naviframe = nullptr;
	runFor(0.02);
}

void UiTest::pressKey(const char *keyName)
{
	Evas *evas = evas_object_evas_get(window->getEvasObj());
	evas_event_feed_key_down(evas, keyName, keyName, nullptr, nullptr, 0, nullptr);
	evas_event_feed_key_up(evas, keyName, keyName, nullptr, nullptr, 0, nullptr);
	runFor(0.05);
}

namespace
{
struct LoopWait {
	const std::function<bool()> *pred;
	double end;
};
} // namespace

static Eina_Bool checkLoopWaitCb(void *data)
{
	LoopWait *wait = static_cast<LoopWait *>(data);
	if ((*wait->pred)() || ecore_time_get() > wait->end) {
		ecore_main_loop_quit();
		return ECORE_CALLBACK_CANCEL;
	}
	return ECORE_CALLBACK_RENEW;
}

bool UiTest::waitFor(const std::function<bool()> &pred)
{
	if (pred())
		return true;
	LoopWait wait = {&pred, ecore_time_get() + 3.0};
	ecore_timer_add(0.005, checkLoopWaitCb, &wait);
	ecore_main_loop_begin();
	return pred();
}

void UiTest::runFor(double seconds)
{
	double end = ecore_time_get() + seconds;
	waitFor([end] { return ecore_time_get() > end; });
}

LoggingPage::LoggingPage(const std::string &tag, std::vector<std::string> *log, bool failCreate)
    : __tag(tag), __log(log), __failCreate(failCreate)
{
	__log->push_back(__tag + ":constructor");
}

LoggingPage::~LoggingPage()
{
	__log->push_back(__tag + ":destructor");
}

Evas_Object *LoggingPage::onCreateView(Evas_Object *parent, void *param)
{
	__log->push_back(__tag + ":onCreateView");
	receivedParam = param;
	if (__failCreate)
		return nullptr;
	Evas_Object *label = elm_label_add(parent);
	elm_object_text_set(label, ("Page " + __tag).c_str());
	evas_object_show(label);
	return label;
}

void LoggingPage::onCreated()
{
	__log->push_back(__tag + ":onCreated");
}

void LoggingPage::onPushed(Elm_Object_Item *naviItem)
{
	__log->push_back(__tag + (naviItem == getNaviItem() ? ":onPushed" : ":onPushed(wrong item)"));
}

void LoggingPage::onPop()
{
	__log->push_back(__tag + ":onPop");
}

void LoggingPage::onBecomeTop()
{
	__log->push_back(__tag + ":onBecomeTop");
}

void LoggingPage::onDestroy()
{
	__log->push_back(__tag + ":onDestroy");
}

} // namespace aa_test
