#include "TestEnv.h"

#include <Ecore.h>
#include <Ecore_Evas.h>
#include <Elementary.h>
#include <sqlite3.h>

#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <sstream>
#include <sys/stat.h>
#include <sys/statvfs.h>
#include <sys/wait.h>
#include <vector>

namespace memo_test
{
const std::string &tempRoot()
{
	// In memory where there is room: SQLite and the key stores sync every write, which costs a disk
	// seconds. Containers often mount a small /dev/shm, so it needs 512 MiB free.
	static const std::string root = [] {
		char shm[] = "/dev/shm/memo-test-XXXXXX", tmp[] = "/tmp/memo-test-XXXXXX";
		struct statvfs fs;
		bool roomy = statvfs("/dev/shm", &fs) == 0 && (unsigned long long)fs.f_bavail * fs.f_frsize >= (512ull << 20);
		return std::string(roomy && mkdtemp(shm) ? shm : mkdtemp(tmp) ? tmp : "");
	}();
	return root;
}

std::string makeTempDir(const std::string &name)
{
	static int counter = 0;
	std::string dir = tempRoot() + "/" + name + "-" + std::to_string(++counter);
	mkdir(dir.c_str(), 0700);
	return dir;
}

bool pump(double timeoutSec, const std::function<bool()> &pred)
{
	double end = ecore_time_get() + timeoutSec;
	while (!pred()) {
		if (ecore_time_get() > end)
			return pred();
		ecore_main_loop_iterate();
		usleep(1000);
	}
	return true;
}

void pumpFor(double seconds)
{
	pump(seconds, [] { return false; });
}

void initElementary()
{
	static int ready = elm_init(0, nullptr);
	(void)ready;
}

Evas_Object *addShownWindow(const char *name)
{
	initElementary();
	Evas_Object *win = elm_win_add(nullptr, name, ELM_WIN_BASIC);
	evas_object_resize(win, 480, 800);
	evas_object_show(win);
	waitForFrame(win);
	return win;
}

bool waitForFrame(Evas_Object *win)
{
	bool rendered = false;
	Evas_Event_Cb renderedCb = [](void *data, Evas *, void *) { *static_cast<bool *>(data) = true; };
	evas_event_callback_add(evas_object_evas_get(win), EVAS_CALLBACK_RENDER_POST, renderedCb, &rendered);
	pump(5.0, [&] { return rendered; });
	evas_event_callback_del_full(evas_object_evas_get(win), EVAS_CALLBACK_RENDER_POST, renderedCb, &rendered);
	return rendered;
}

std::string helperPath(const std::string &name)
{
	return std::string(TEST_HELPER_DIR) + "/" + name;
}

bool saveScreenshot(Evas_Object *win, const std::string &pngPath)
{
	Evas *evas = evas_object_evas_get(win);
	Ecore_Evas *ee = ecore_evas_ecore_evas_get(evas);
	if (!ee)
		return false;
	ecore_evas_manual_render(ee);
	int w = 0, h = 0;
	ecore_evas_geometry_get(ee, nullptr, nullptr, &w, &h);
	const void *pixels = ecore_evas_buffer_pixels_get(ee);
	if (!pixels || w <= 0 || h <= 0)
		return false;
	// Copy into an image object so that Evas' own PNG saver writes it.
	Evas_Object *img = evas_object_image_add(evas);
	evas_object_image_colorspace_set(img, EVAS_COLORSPACE_ARGB8888);
	evas_object_image_alpha_set(img, EINA_FALSE);
	evas_object_image_size_set(img, w, h);
	evas_object_image_data_copy_set(img, const_cast<void *>(pixels));
	Eina_Bool ok = evas_object_image_save(img, pngPath.c_str(), nullptr, "compress=6");
	evas_object_del(img);
	return ok;
}

int runCommand(const std::string &cmd, std::string *out)
{
	FILE *p = popen(cmd.c_str(), "r");
	if (!p)
		return -1;
	char buf[4096];
	size_t n;
	std::string text;
	while ((n = fread(buf, 1, sizeof(buf), p)) > 0)
		text.append(buf, n);
	int status = pclose(p);
	if (out)
		*out = text;
	return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
}

std::string readFile(const std::string &path)
{
	std::ifstream in(path, std::ios::binary);
	std::stringstream ss;
	ss << in.rdbuf();
	return ss.str();
}

std::string queryFirst(const std::string &dbPath, const std::string &sql)
{
	std::string result;
	sqlite3 *db = nullptr;
	sqlite3_stmt *stmt = nullptr;
	if (sqlite3_open_v2(dbPath.c_str(), &db, SQLITE_OPEN_READWRITE, nullptr) == SQLITE_OK &&
	    sqlite3_prepare_v2(db, sql.c_str(), -1, &stmt, nullptr) == SQLITE_OK && sqlite3_step(stmt) == SQLITE_ROW &&
	    sqlite3_column_text(stmt, 0))
		result = reinterpret_cast<const char *>(sqlite3_column_text(stmt, 0));
	sqlite3_finalize(stmt);
	sqlite3_close(db);
	return result;
}
} // namespace memo_test
