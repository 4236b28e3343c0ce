// Typing into the search over 10,000 memos: the app (MemoApp on the buffer engine, 480 x 800) opens the
// search page, then a five-letter word is typed one key at a time into its real field, and BackSpace takes
// it out again, several rounds. For each keystroke: the time from the key event to the end of the first frame
// that shows its results (goal 16 ms), median and worst per key; then the same prefixes through the store's
// search alone, so that the part of the store in each keystroke shows.
#include "DataBase/MemoDbMgr.h"
#include "DataBase/MemoDocInfo.h"
#include "List/MemoItemList.h"
#include "MemoApp.h"
#include "View/MemoSearchView.h"

#include "BenchEnv.h"

#include <Ecore.h>
#include <Ecore_Evas.h>
#include <Elementary.h>
#include <app_control.h>

#include <WNaviframeController.h>
#include <WWindowController.h>

#include <algorithm>
#include <clocale>
#include <cstdio>
#include <cstdlib>
#include <ctime>
#include <string>
#include <unordered_set>
#include <vector>

namespace
{
const int MEMO_COUNT = 10000;
const char WORD[] = "bread";
const int ROUNDS = 5;

double gNow()
{
	timespec t;
	clock_gettime(CLOCK_MONOTONIC, &t);
	return t.tv_sec + t.tv_nsec / 1e9;
}

int gFrames = 0;
// One keystroke being timed: when it was fed, whether the field has reported the change (the search has run
// in its handler), and the end of the first frame after that.
struct Keystroke {
	bool armed = false;
	bool changed = false;
	double start = 0.0;
	double results = -1.0;
} gKey;

void renderPostCb(void *, Evas *, void *)
{
	++gFrames;
	if (gKey.armed && gKey.changed && gKey.results < 0)
		gKey.results = (gNow() - gKey.start) * 1000.0;
}

// Registered after the view's own: the search has been done when this runs.
void entryChangedCb(void *, Evas_Object *, void *)
{
	gKey.changed = true;
}

void runFor(double seconds)
{
	const double end = gNow() + seconds;
	while (gNow() < end)
		ecore_main_loop_iterate();
}

// Feeds one key and runs the loop until a frame shows its results; returns the milliseconds to that frame.
double keyToFrame(Ecore_Evas *canvas, const char *keyName, const char *typed)
{
	static unsigned int stamp = 1000;
	Evas *evas = ecore_evas_get(canvas);
	gKey.armed = true;
	gKey.changed = false;
	gKey.results = -1.0;
	gKey.start = gNow();
	evas_event_feed_key_down(evas, keyName, keyName, typed, typed, ++stamp, nullptr);
	evas_event_feed_key_up(evas, keyName, keyName, typed, typed, ++stamp, nullptr);
	for (int spins = 0; gKey.results < 0; ++spins) {
		ecore_main_loop_iterate();
		// A canvas with nothing to draw renders nothing: a display would still show the next frame.
		if (spins > 20)
			ecore_evas_manual_render(canvas);
	}
	gKey.armed = false;
	const double ms = gKey.results;
	runFor(0.05);
	return ms;
}

void printRow(const char *label, std::vector<double> values, int results)
{
	std::sort(values.begin(), values.end());
	printf("%-12s %6d results   median %7.2f ms   worst %7.2f ms\n", label, results, values[values.size() / 2],
	       values.back());
}

// The memos that a search from the list shows for text: the store's matches that are visible memos.
int visibleMatches(const char *text)
{
	static std::unordered_set<std::string> visible;
	if (visible.empty()) {
		MemoItemList *list = MemoDbMgr::getInstance()->getVisibleMemoListN();
		for (int i = 0; list && i < list->getCount(); ++i)
			visible.insert(list->getItem(i)->getMemoUUID());
		delete list;
	}
	char **uuids = nullptr;
	int count = 0, shown = 0;
	MemoDbMgr::getInstance()->getSearchReultN(text, &uuids, &count);
	for (int i = 0; i < count; ++i) {
		shown += visible.count(uuids[i]) ? 1 : 0;
		free(uuids[i]);
	}
	free(uuids);
	return shown;
}
} // namespace

int main(int argc, char **argv)
{
	const std::string root = memo_bench::setUpPrivateRoot("search");
	if (root.empty())
		return 1;
	if (system((memo_bench::helperPath("memo_seed") + " fill " + std::to_string(MEMO_COUNT) + " >/dev/null 2>&1")
	               .c_str()) != 0) {
		fprintf(stderr, "memo_seed failed\n");
		return 1;
	}
	setenv("LANGUAGE", "en", 1);
	setlocale(LC_MESSAGES, "C.UTF-8");
	elm_init(argc, argv);
	MemoApp *app = new MemoApp();
	if (!app->onCreate())
		return 1;
	app_control_h request = nullptr;
	app_control_create(&request);
	app->onAppControl(request, true);
	app_control_destroy(request);
	app->onResume();
	Evas_Object *win = app->getWindowController()->getEvasObj();
	evas_object_resize(win, 480, 800);
	runFor(0.5);

	auto *naviframe =
	    dynamic_cast<app_assist::WNaviframeController *>(app->getWindowController()->getBaseViewController());
	MemoSearchView *search = new MemoSearchView();
	naviframe->push(search);
	runFor(0.8);
	Evas_Object *bar = elm_object_item_part_content_get(search->getNaviItem(), "title");
	Evas_Object *entry = elm_object_part_content_get(bar, "elm.swallow.searchbar");
	Evas *evas = evas_object_evas_get(win);
	Ecore_Evas *canvas = ecore_evas_ecore_evas_get(evas);
	evas_focus_in(evas);
	elm_object_focus_set(entry, EINA_TRUE);
	evas_event_callback_add(evas, EVAS_CALLBACK_RENDER_POST, renderPostCb, nullptr);
	evas_object_smart_callback_add(entry, "changed", entryChangedCb, nullptr);
	runFor(0.3);

	const int keys = static_cast<int>(sizeof(WORD) - 1);
	std::vector<std::vector<double>> typing(keys), erasing(keys);
	std::vector<int> cards(keys);
	for (int round = 0; round < ROUNDS; ++round) {
		for (int k = 0; k < keys; ++k) {
			const char typed[2] = {WORD[k], '\0'};
			typing[k].push_back(keyToFrame(canvas, typed, typed));
			Evas_Object *grid = elm_object_part_content_get(search->getEvasObj(), "contents");
			const char *type = grid ? elm_object_widget_type_get(grid) : "";
			cards[k] = std::string(type ? type : "").find("Gengrid") != std::string::npos
			               ? static_cast<int>(elm_gengrid_items_count(grid))
			               : 0;
		}
		for (int k = keys - 1; k >= 0; --k)
			erasing[k].push_back(keyToFrame(canvas, "BackSpace", nullptr));
	}
	std::vector<int> shown(keys);
	for (int k = 0; k < keys; ++k)
		shown[k] = visibleMatches(std::string(WORD, k + 1).c_str());

	printf("Search over %d memos, \"%s\" typed %d times into the search field (480 x 800, buffer engine)\n", MEMO_COUNT,
	       WORD, ROUNDS);
	printf("Key event to the end of the first frame that shows the key's results, typing (cards made: %d to %d):\n",
	       *std::min_element(cards.begin(), cards.end()), *std::max_element(cards.begin(), cards.end()));
	for (int k = 0; k < keys; ++k)
		printRow(std::string(WORD, k + 1).c_str(), typing[k], shown[k]);
	printf("... and BackSpace back to the shorter text:\n");
	for (int k = keys - 1; k >= 0; --k)
		printRow(k ? std::string(WORD, k).c_str() : "(empty)", erasing[k], k ? shown[k - 1] : -1);
	std::vector<double> all;
	for (int k = 0; k < keys; ++k)
		all.insert(all.end(), typing[k].begin(), typing[k].end());
	for (int k = 0; k < keys; ++k)
		all.insert(all.end(), erasing[k].begin(), erasing[k].end());
	printRow("every key", all, -1);

	printf("The store's search alone (getSearchReultN), per prefix:\n");
	for (int k = 0; k <= keys; ++k) {
		const std::string prefix(WORD, k);
		std::vector<double> times;
		int count = 0;
		for (int i = 0; i < ROUNDS; ++i) {
			char **uuids = nullptr;
			const double start = gNow();
			MemoDbMgr::getInstance()->getSearchReultN(prefix.c_str(), &uuids, &count);
			times.push_back((gNow() - start) * 1000.0);
			for (int u = 0; u < count; ++u)
				free(uuids[u]);
			free(uuids);
		}
		printRow(k ? prefix.c_str() : "(empty)", times, count);
	}

	app->onTerminate();
	delete app;
	elm_shutdown();
	system(("rm -rf '" + root + "'").c_str());
	return 0;
}
