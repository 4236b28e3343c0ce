#ifndef TESTS_UI_BOX_CONTROL_FIXTURE_H
#define TESTS_UI_BOX_CONTROL_FIXTURE_H

// A real box control in the test window's scroller, with every key it signals recorded.

#include <Ecore_File.h>

#include <cstring>
#include <string>
#include <vector>

#include "Box/MemoBoxControl.h"
#include "Box/MemoBoxItem.h"
#include "DataBase/MemoDocInfo.h"
#include "Util/MemoUtil.h"
#include "support/UiTestSupport.h"

namespace memo_ui_test
{

// One todolist line as the store keeps it, for an item holding `markup`.
inline std::string todoItem(int type, bool state, const std::string &markup)
{
	std::string content;
	for (char c : markup)
		content += c == '<' ? "&lt;" : c == '>' ? "&gt;" : c == '&' ? "&amp;" : c == '"' ? "&quot;" : std::string(1, c);
	return std::string("<todolist_item todo_item_type=\"") + std::to_string(type) + "\" todo_item_state=\"" +
	       (state ? "true" : "false") + "\" todo_item_content=\"" + content + "\"/>\n";
}

inline std::string todoList(const std::string &lines)
{
	return "<todolist>\n" + lines + "</todolist>\n";
}

// A picture tag as the editor writes it.
inline std::string tag(int w, int h, const std::string &path)
{
	return "<item size=" + std::to_string(w) + "x" + std::to_string(h) + " vsize=full href=file://" + path + "></item>";
}

class BoxControlFixture : public UiFixture
{
protected:
	// Builds a control for `doc` (may be null) in `mode`, as the scroller's content.
	MemoBoxControl *makeControl(MemoDocInfo *doc, int mode, const char *uuid = "box-test-memo")
	{
		control = new MemoBoxControl(doc, mode, uuid);
		EXPECT_TRUE(control->create(scroller, nullptr));
		control->getSignal().addListener([this](const char *key, void *payload) {
			keys.push_back(key);
			payloads.push_back(payload && strcmp(key, "action,image,selected") == 0 ? static_cast<char *>(payload)
			                                                                        : "");
		});
		render();
		runFor(0.05);
		return control;
	}

	// A control in `mode` on `record`, whose body becomes `lines` (todolist items); a second call
	// within one test replaces the control.
	MemoBoxControl *withBody(const std::string &lines, int mode = MODE_UPDATE)
	{
		record.setMemoUUID("box-test-memo");
		record.setTizenXmlContent(todoList(lines).c_str());
		return control ? remakeControl(&record, mode) : makeControl(&record, mode);
	}

	// A fresh control in the same window, for a second set-up within one test.
	MemoBoxControl *remakeControl(MemoDocInfo *doc, int mode, const char *uuid = "box-test-memo")
	{
		control->destroy();
		keys.clear();
		payloads.clear();
		desktop_toast_log_clear();
		return makeControl(doc, mode, uuid);
	}

	std::vector<MemoBoxItem *> items() const
	{
		std::vector<MemoBoxItem *> result;
		const Eina_List *l = nullptr;
		void *data = nullptr;
		EINA_LIST_FOREACH(control->getItemList(), l, data)
		result.push_back(static_cast<MemoBoxItem *>(data));
		return result;
	}

	// The item layouts in the order the box shows them.
	std::vector<Evas_Object *> packed() const
	{
		std::vector<Evas_Object *> result;
		Eina_List *children = elm_box_children_get(control->getEvasObj());
		void *data = nullptr;
		EINA_LIST_FREE(children, data)
		result.push_back(static_cast<Evas_Object *>(data));
		return result;
	}

	static std::string text(MemoBoxItem *item)
	{
		const char *t = item && item->getEntry() ? elm_entry_entry_get(item->getEntry()) : nullptr;
		return t ? t : "";
	}

	static std::string document(MemoBoxControl *from)
	{
		char *xml = from->getTodoListXmlN();
		std::string result = xml ? xml : "<null>";
		free(xml);
		return result;
	}

	int countKey(const char *key) const
	{
		int n = 0;
		for (const std::string &k : keys)
			n += k == key ? 1 : 0;
		return n;
	}

	std::string lastKey() const { return keys.empty() ? "" : keys.back(); }

	std::string titleText() const
	{
		char *t = control->getTitleTextN();
		std::string result = t ? t : "<null>";
		free(t);
		return result;
	}

	// The kinds and texts of the body items, e.g. "5:l1 1:l2 0:l3".
	std::string shape() const
	{
		std::string out;
		for (MemoBoxItem *item : items())
			out += (out.empty() ? "" : " ") + std::to_string(item->getType()) + ":" + text(item);
		return out;
	}

	// Focuses the item's entry and puts the cursor at `pos` (-1: the end).
	void focusAt(MemoBoxItem *item, int pos = -1)
	{
		focus(item->getEntry());
		if (pos < 0)
			elm_entry_cursor_end_set(item->getEntry());
		else
			elm_entry_cursor_pos_set(item->getEntry(), pos);
		runFor(0.03);
	}

	// The memo's media folder, made.
	static std::string mediaDir(const char *uuid = "box-test-memo")
	{
		const std::string dir = std::string(MemoUtil::getDataPath()) + "media/" + uuid + "/";
		ecore_file_mkpath(dir.c_str());
		return dir;
	}

	// A picture of w x h in the memo's media folder.
	static std::string picture(const char *name, int w = 1000, int h = 500)
	{
		const std::string path = mediaDir() + name;
		EXPECT_TRUE(writePicture(path, w, h));
		return path;
	}

	MemoBoxControl *control = nullptr;
	MemoDocInfo record;
	std::vector<std::string> keys;
	std::vector<std::string> payloads;
};

} // namespace memo_ui_test

#endif
