// memo_seed: fills the store of $TIZEN_APP_ROOT with memos as the editor saves them.
//   memo_seed demo      nine varied memos for screenshots: colours, check lines, pictures, a favourite
//                       and text in the quick memo
//   memo_seed fill <n>  n generated memos (a third checklists, some favourites, hidden, coloured, with a
//                       picture or a recording), their sync columns left NULL as the sync service leaves them
// Exit status 0 when every memo was written.
#include <Ecore_Evas.h>
#include <Ecore_File.h>
#include <Elementary.h>

#include <cmath>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <random>
#include <string>
#include <vector>

#include "DataBase/MemoDbMgr.h"
#include "DataBase/MemoDocInfo.h"
#include "MemoCvt.h"
#include "Util/MemoUtil.h"

namespace
{

struct Line {
	int type; // 0 text, 1 check
	bool ticked;
	std::string text;
};

std::string xmlEscape(const std::string &text)
{
	std::string out;
	for (char c : text) {
		if (c == '&')
			out += "&amp;amp;";
		else if (c == '<')
			out += "&amp;lt;";
		else if (c == '>')
			out += "&amp;gt;";
		else if (c == '"')
			out += "&quot;";
		else
			out += c;
	}
	return out;
}

std::string document(const std::vector<Line> &lines)
{
	std::string doc = "<todolist>\n";
	for (const Line &line : lines)
		doc += "<todolist_item todo_item_type=\"" + std::to_string(line.type) + "\" todo_item_state=\"" +
		       (line.ticked ? "true" : "false") + "\" todo_item_content=\"" + xmlEscape(line.text) + "\"/>\n";
	return doc + "</todolist>\n";
}

// A landscape of sky, sun and two hills, as a JPEG of w x h; false when Evas cannot save it.
bool writeScene(const std::string &path, int w, int h, uint32_t sky, uint32_t hill)
{
	Ecore_Evas *ee = ecore_evas_buffer_new(1, 1);
	Evas_Object *img = evas_object_image_add(ecore_evas_get(ee));
	evas_object_image_size_set(img, w, h);
	uint32_t *px = static_cast<uint32_t *>(evas_object_image_data_get(img, EINA_TRUE));
	const int stride = evas_object_image_stride_get(img) / 4;
	auto channel = [](uint32_t c, int shift) { return static_cast<int>((c >> shift) & 0xff); };
	for (int y = 0; y < h; y++) {
		for (int x = 0; x < w; x++) {
			double fy = static_cast<double>(y) / h, fx = static_cast<double>(x) / w;
			int r = channel(sky, 16) + static_cast<int>(40 * fy), g = channel(sky, 8) + static_cast<int>(30 * fy),
			    b = channel(sky, 0) - static_cast<int>(20 * fy);
			if (std::hypot(fx - 0.72, (fy - 0.3) * h / w) < 0.09)
				r = 255, g = 236, b = 170;
			double ridge1 = 0.62 + 0.06 * std::sin(fx * 5.0 + 1.0), ridge2 = 0.74 + 0.05 * std::sin(fx * 4.0 + 2.5);
			if (fy > ridge1)
				r = channel(hill, 16), g = channel(hill, 8), b = channel(hill, 0);
			if (fy > ridge2)
				r = channel(hill, 16) * 3 / 4, g = channel(hill, 8) * 3 / 4, b = channel(hill, 0) * 3 / 4;
			auto clamp = [](int v) { return static_cast<uint32_t>(v < 0 ? 0 : (v > 255 ? 255 : v)); };
			px[y * stride + x] = 0xff000000u | (clamp(r) << 16) | (clamp(g) << 8) | clamp(b);
		}
	}
	evas_object_image_data_set(img, px);
	Eina_Bool ok = evas_object_image_save(img, path.c_str(), nullptr, "quality=88");
	ecore_evas_free(ee);
	return ok;
}

struct Memo {
	std::string title;
	std::vector<Line> lines;
	std::string color;
	int favourite = 0;
	int hidden = 0;
	bool voice = false;
	std::string picture; // a scene is drawn for it when not empty
	uint32_t sky = 0x7fb0e0, hill = 0x3f7a4c;
};

unsigned long long gTime = 1700000000000ULL;

bool write(MemoDbMgr *db, const Memo &memo)
{
	MemoDocInfo info;
	char *title = elm_entry_utf8_to_markup(memo.title.c_str());
	info.setTitle(title);
	free(title);
	const std::string doc = document(memo.lines);
	MemoCvt cvt(MEMO_CVT_SRC_TODOLIST, doc);
	info.setDisplayContent(cvt.getDisplayContent().c_str());
	info.setStrippedContent(cvt.getStrippedContent().c_str());
	info.setContent(cvt.getContent().c_str());
	info.setAndroidXmlContent(cvt.getXmlContent().c_str());
	info.setTizenXmlContent(doc.c_str());
	gTime += 60000;
	info.setCreatedAt(gTime);
	info.setLastModifiedAt(gTime);
	info.setIsFavorite(memo.favourite);
	info.setIsHidden(memo.hidden);
	if (!memo.color.empty())
		info.setBgColor(memo.color.c_str());
	std::string uuid = info.getMemoUUID();
	const std::string folder = std::string(MemoUtil::getDataPath()) + "media/" + uuid + "/";
	if (memo.voice) {
		char *voice = nullptr;
		MemoUtil::createUUIDN(&voice);
		info.setVrfileUUID(voice);
		free(voice);
	}
	if (!memo.picture.empty()) {
		ecore_file_mkpath((folder + "thumb").c_str());
		const std::string picture = folder + memo.picture;
		const std::string thumb = folder + "thumb/" + uuid + ".jpg";
		if (!writeScene(picture, 640, 420, memo.sky, memo.hill) || !writeScene(thumb, 320, 210, memo.sky, memo.hill))
			return false;
		info.setData(thumb.c_str());
		info.setFileCount(1);
		MemoFileInfo &file = info.getFiles()[0];
		char *fileUuid = nullptr;
		MemoUtil::createUUIDN(&fileUuid);
		file.setFileUUID(fileUuid);
		free(fileUuid);
		file.setMemoUUID(uuid.c_str());
		file.setMimeType("image/jpeg");
		file.setDisplayName(memo.picture.c_str());
		file.setPath(picture.c_str());
	}
	return db->addMemo(&info);
}

Line text(const std::string &t)
{
	return {0, false, t};
}
Line check(const std::string &t, bool ticked = false)
{
	return {1, ticked, t};
}

Memo make(const std::string &title, const std::vector<Line> &lines, const std::string &color, int favourite = 0)
{
	Memo memo;
	memo.title = title;
	memo.lines = lines;
	memo.color = color;
	memo.favourite = favourite;
	return memo;
}

int demo(MemoDbMgr *db)
{
	std::vector<Memo> memos(9);
	memos[0] =
	    make("Weekend at the lake", {text("We leave on Friday at six & meet at the pier.")}, "255;229;153;255;", 1);
	memos[0].picture = "lake01.jpg";
	memos[1] =
	    make("Groceries",
	         {check("Milk", true), check("Eggs"), check("Bread", true), check("Tomatoes"), check("Coffee beans")},
	         "205;232;196;255;");
	memos[2] = make("", {text("Call the garage about the winter tyres before the first frost.")}, "228;235;235;255;");
	memos[3] = make("Book club", {text("Next: The Left Hand of Darkness"), text("Bring the spare copy for Ana.")},
	                "214;226;250;255;");
	memos[4] = make("Packing", {check("Passport", true), check("Chargers"), check("Sunscreen")}, "250;214;226;255;");
	memos[5] = make("Ideas for the garden", {text("Raised beds by the fence")}, "226;240;214;255;");
	memos[5].picture = "garden01.jpg";
	memos[5].sky = 0xe8b4a0;
	memos[5].hill = 0x5a4a6e;
	memos[6] = make("Interview notes", {text("Recorded the answers; summary to follow.")}, "236;224;250;255;");
	memos[6].voice = true;
	memos[7] = make("Wi-Fi at the cabin", {text("Network: lakeside-5G")}, "255;236;214;255;");
	memos[8] = make("Recipe: pancakes",
	                {check("200 g flour", true), check("2 eggs", true), check("300 ml milk"), text("Rest 20 minutes.")},
	                "255;243;205;255;");
	for (const Memo &memo : memos)
		if (!write(db, memo))
			return 1;
	db->addQuickMemo("Pick up the parcel at the post office");
	db->addQuickMemo("Ana's new number: 0171 555 0199");
	return 0;
}

const char *const WORDS[] = {"milk",     "bread",   "plan",   "review", "notes",  "idea",   "garden",
                             "travel",   "train",   "ticket", "gift",   "recipe", "budget", "invoice",
                             "doctor",   "book",    "film",   "music",  "run",    "family", "school",
                             "homework", "report",  "draft",  "email",  "reply",  "phone",  "repair",
                             "car",      "holiday", "beach",  "hotel",  "flight", "paint",  "kitchen"};
const char *const COLORS[] = {"228;235;235;255;", "255;229;153;255;", "205;232;196;255;",
                              "214;226;250;255;", "250;214;226;255;", "236;224;250;255;"};

int fill(MemoDbMgr *db, int count)
{
	std::mt19937 random(20240611);
	auto words = [&](int n) {
		std::string s;
		for (int i = 0; i < n; ++i)
			s += (i ? " " : "") + std::string(WORDS[random() % (sizeof(WORDS) / sizeof(WORDS[0]))]);
		return s;
	};
	db->excuteSql("BEGIN");
	for (int i = 0; i < count; ++i) {
		Memo memo;
		if (random() % 7)
			memo.title = words(1 + static_cast<int>(random() % 4));
		const bool checklist = random() % 3 == 0;
		const int lines = 1 + static_cast<int>(random() % 8);
		for (int l = 0; l < lines; ++l)
			memo.lines.push_back(checklist ? check(words(2 + static_cast<int>(random() % 4)), random() % 2)
			                               : text(words(3 + static_cast<int>(random() % 8))));
		memo.color = COLORS[random() % (sizeof(COLORS) / sizeof(COLORS[0]))];
		memo.favourite = random() % 10 == 0;
		memo.hidden = random() % 20 == 0;
		memo.voice = random() % 20 == 0;
		if (!write(db, memo)) {
			db->excuteSql("ROLLBACK");
			return 1;
		}
	}
	db->excuteSql("COMMIT");
	// Rows that came through the sync service carry no account and no sync2.
	db->excuteSql("UPDATE memo SET accountType = NULL, sync2 = NULL");
	return 0;
}

} // namespace

int main(int argc, char **argv)
{
	if (argc < 2 || (strcmp(argv[1], "demo") && (strcmp(argv[1], "fill") || argc < 3))) {
		fprintf(stderr, "usage: %s demo | fill <count>\n", argv[0]);
		return 2;
	}
	elm_init(argc, argv);
	MemoDbMgr *db = MemoDbMgr::getInstance();
	int rc = !strcmp(argv[1], "demo") ? demo(db) : fill(db, atoi(argv[2]));
	MemoDbMgr::destroy();
	elm_shutdown();
	return rc;
}
