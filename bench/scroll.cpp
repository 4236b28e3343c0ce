// Flinging through 10,000 cards of the main list's grid (buffer engine, 480 x 800 at scale 1.0): repeated
// flings for a few seconds, then an animated jump to the last card. Prints the longest main-loop iteration
// (from leaving idle to entering it again, the frame's rendering included), the 99th percentile, and the
// frame times (render start to render end, and between the starts of frames). Goal: no iteration over 16 ms.
#include "DataBase/MemoDbMgr.h"
#include "List/MemoGridControl.h"
#include "MemoApp.h"
#include "Util/MemoUtil.h"

#include "BenchEnv.h"

#include <Ecore.h>
#include <Ecore_Evas.h>
#include <Elementary.h>
#include <uxt_theme.h>

#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <ctime>
#include <string>
#include <vector>

namespace
{
// MEMO_BENCH_COUNT=<n> flings through n memos instead, to see how the cost grows with the grid.
const int MEMO_COUNT = getenv("MEMO_BENCH_COUNT") ? atoi(getenv("MEMO_BENCH_COUNT")) : 10000;
const double FLING_SECONDS = 6.0;

struct Timeline {
	double workStart = -1, workCpuStart = -1;
	std::vector<double> iterations, iterationsCpu; // ms
	double renderStart = -1, renderCpuStart = -1, lastRenderStart = -1;
	std::vector<double> renders, rendersCpu, intervals; // ms
};

// The main thread's CPU time in seconds: what the work costs apart from waiting for a busy machine.
double cpuNow()
{
	timespec t;
	clock_gettime(CLOCK_THREAD_CPUTIME_ID, &t);
	return t.tv_sec + t.tv_nsec / 1e9;
}

Timeline gTime;

Eina_Bool idleExiterCb(void *)
{
	gTime.workStart = ecore_time_get();
	gTime.workCpuStart = cpuNow();
	return ECORE_CALLBACK_RENEW;
}

Eina_Bool idleEntererCb(void *)
{
	if (gTime.workStart >= 0) {
		gTime.iterations.push_back((ecore_time_get() - gTime.workStart) * 1000.0);
		gTime.iterationsCpu.push_back((cpuNow() - gTime.workCpuStart) * 1000.0);
	}
	gTime.workStart = -1;
	return ECORE_CALLBACK_RENEW;
}

void renderPreCb(void *, Evas *, void *)
{
	gTime.renderStart = ecore_time_get();
	gTime.renderCpuStart = cpuNow();
	if (gTime.lastRenderStart >= 0)
		gTime.intervals.push_back((gTime.renderStart - gTime.lastRenderStart) * 1000.0);
	gTime.lastRenderStart = gTime.renderStart;
}

void renderPostCb(void *, Evas *, void *)
{
	if (gTime.renderStart >= 0) {
		gTime.renders.push_back((ecore_time_get() - gTime.renderStart) * 1000.0);
		gTime.rendersCpu.push_back((cpuNow() - gTime.renderCpuStart) * 1000.0);
	}
}

void runFor(double seconds)
{
	ecore_timer_add(
	    seconds,
	    [](void *) -> Eina_Bool {
		    ecore_main_loop_quit();
		    return ECORE_CALLBACK_CANCEL;
	    },
	    nullptr);
	ecore_main_loop_begin();
}

// A finger's flings at a display's pace: every 1/60 s the grid moves by a speed that starts at 6,000 px/s
// and halves every 0.2 s, a new fling starting when it falls below 200 px/s; then the frame is drawn (the
// buffer engine draws only when asked, as a display's refresh asks it).
struct Flinger {
	Evas_Object *grid;
	Ecore_Evas *canvas;
	double speed = 0;
	double y = 0;
	double endTime = 0;
	int flings = 0;
};

Eina_Bool frameCb(void *data)
{
	Flinger *f = static_cast<Flinger *>(data);
	const double dt = 1.0 / 60.0;
	if (f->speed < 200) {
		f->speed = 6000;
		++f->flings;
	}
	f->y += f->speed * dt;
	f->speed *= 0.9439; // halves in 12 frames
	Evas_Coord w = 0, h = 0;
	elm_scroller_region_get(f->grid, nullptr, nullptr, &w, &h);
	elm_scroller_region_show(f->grid, 0, static_cast<Evas_Coord>(f->y), w, h);
	ecore_evas_manual_render(f->canvas);
	if (ecore_time_get() > f->endTime) {
		ecore_main_loop_quit();
		return ECORE_CALLBACK_CANCEL;
	}
	return ECORE_CALLBACK_RENEW;
}

void report(const char *name, std::vector<double> values)
{
	if (values.empty()) {
		printf("%-22s none\n", name);
		return;
	}
	std::sort(values.begin(), values.end());
	double sum = 0;
	for (double v : values)
		sum += v;
	size_t over = static_cast<size_t>(std::count_if(values.begin(), values.end(), [](double v) { return v > 16.0; }));
	printf("%-22s n %5zu  mean %6.2f ms  p50 %6.2f  p99 %6.2f  max %6.2f  over 16 ms: %zu\n", name, values.size(),
	       sum / values.size(), values[values.size() / 2], values[values.size() * 99 / 100], values.back(), over);
}
} // namespace

int main(int argc, char **argv)
{
	const std::string root = memo_bench::setUpPrivateRoot("scroll");
	if (root.empty())
		return 1;
	if (system((memo_bench::helperPath("memo_seed") + " fill " + std::to_string(MEMO_COUNT) + " >/dev/null 2>&1")
	               .c_str()) != 0) {
		fprintf(stderr, "memo_seed failed\n");
		return 1;
	}
	elm_init(argc, argv);
	elm_app_base_scale_set(2.6);
	elm_theme_extension_add(nullptr, MemoUtil::getEdjePath());
	Uxt_Theme_Color_Table *colors =
	    uxt_theme_add_color_table((std::string(MemoUtil::getResourcePath()) + "table/memo_color_table.xml").c_str());
	uxt_theme_set_color_table(colors);

	Evas_Object *win = elm_win_add(nullptr, "scroll", ELM_WIN_BASIC);
	Evas_Object *bg = elm_bg_add(win);
	elm_win_resize_object_add(win, bg);
	evas_object_show(bg);
	MemoGridControl *grid = new MemoGridControl();
	grid->create(win, nullptr);
	elm_win_resize_object_add(win, grid->getEvasObj());
	evas_object_resize(win, 480, 800);
	evas_object_show(win);
	grid->updateGrid();
	runFor(0.5);

	Evas *evas = evas_object_evas_get(win);
	evas_event_callback_add(evas, EVAS_CALLBACK_RENDER_PRE, renderPreCb, nullptr);
	evas_event_callback_add(evas, EVAS_CALLBACK_RENDER_POST, renderPostCb, nullptr);
	Ecore_Idle_Exiter *exiter = ecore_idle_exiter_add(idleExiterCb, nullptr);
	Ecore_Idle_Enterer *enterer = ecore_idle_enterer_add(idleEntererCb, nullptr);

	Flinger flinger;
	flinger.grid = grid->getEvasObj();
	flinger.canvas = ecore_evas_ecore_evas_get(evas);
	flinger.endTime = ecore_time_get() + FLING_SECONDS;
	ecore_timer_add(1.0 / 60.0, frameCb, &flinger);
	ecore_main_loop_begin();
	Evas_Coord y = 0, childHeight = 0;
	elm_scroller_region_get(grid->getEvasObj(), nullptr, &y, nullptr, nullptr);
	elm_scroller_child_size_get(grid->getEvasObj(), nullptr, &childHeight);

	printf("Flinging through %u cards (%d px of grid) for %.0f s at 60 frames a second: %d flings, %d px\n",
	       elm_gengrid_items_count(grid->getEvasObj()), childHeight, FLING_SECONDS, flinger.flings, y);
	report("iteration, wall", gTime.iterations);
	report("iteration, cpu", gTime.iterationsCpu);
	report("frame render, wall", gTime.renders);
	report("frame render, cpu", gTime.rendersCpu);
	report("frame interval, wall", gTime.intervals);

	ecore_idle_exiter_del(exiter);
	ecore_idle_enterer_del(enterer);
	evas_object_del(win);
	MemoDbMgr::destroy();
	elm_shutdown();
	system(("rm -rf '" + root + "'").c_str());
	return 0;
}
