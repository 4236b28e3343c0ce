#include "FakeBoxOwner.h"

#include <algorithm>

namespace memo_ui_test
{

FakeBoxOwner::FakeBoxOwner(Evas_Object *box, const char *memoUuid) : __box(box), __uuid(memoUuid ? memoUuid : "") {}

FakeBoxOwner::~FakeBoxOwner()
{
	for (MemoBoxItem *item : items) {
		Evas_Object *layout = item->getLayout();
		delete item;
		if (layout)
			evas_object_del(layout);
	}
}

MemoBoxItem *FakeBoxOwner::addItem(_MemoBoxItemType type, bool editable)
{
	MemoBoxItem *item = new MemoBoxItem(type, __uuid.c_str(), editable);
	Evas_Object *layout = item->create(__box, nullptr, this);
	if (layout)
		elm_box_pack_end(__box, layout);
	items.push_back(item);
	return item;
}

void FakeBoxOwner::removeItem(MemoBoxItem *item)
{
	items.erase(std::remove(items.begin(), items.end(), item), items.end());
	Evas_Object *layout = item->getLayout();
	if (layout)
		elm_box_unpack(__box, layout);
	delete item;
	if (layout)
		evas_object_del(layout);
}

int FakeBoxOwner::count(const std::string &prefix) const
{
	return static_cast<int>(std::count_if(
	    calls.begin(), calls.end(), [&](const std::string &c) { return c.compare(0, prefix.size(), prefix) == 0; }));
}

void FakeBoxOwner::onUnpackRequested(Evas_Object *entry, void *item)
{
	(void)entry;
	calls.push_back("unpack");
	MemoBoxItem *gone = static_cast<MemoBoxItem *>(item);
	auto it = std::find(items.begin(), items.end(), gone);
	if (!allowUnpack || items.size() < 2 || it == items.end())
		return;
	MemoBoxItem *neighbour = it == items.begin() ? *(it + 1) : *(it - 1);
	const char *text = elm_entry_entry_get(gone->getEntry());
	std::string moved = text ? text : "";
	removeItem(gone);
	if (neighbour->getEntry()) {
		elm_entry_cursor_end_set(neighbour->getEntry());
		if (!moved.empty())
			elm_entry_entry_insert(neighbour->getEntry(), moved.c_str());
	}
}

MemoBoxItem *FakeBoxOwner::onAddRequested(Evas_Object *entry, _MemoBoxItemType type, const char *text, void *item)
{
	(void)entry;
	calls.push_back("add:" + std::to_string(type) + ":" + (text ? text : "(null)"));
	if (type == MEMO_BOX_ITEM_TITLE)
		return nullptr;
	MemoBoxItem *asker = static_cast<MemoBoxItem *>(item);
	MemoBoxItem *added = new MemoBoxItem(type, __uuid.c_str(), true);
	Evas_Object *layout = added->create(__box, nullptr, this);
	if (text)
		added->insertText(text);
	auto it = std::find(items.begin(), items.end(), asker);
	if (it == items.end()) {
		elm_box_pack_end(__box, layout);
		items.push_back(added);
	} else {
		elm_box_pack_after(__box, layout, asker->getLayout());
		items.insert(it + 1, added);
	}
	return added;
}

void FakeBoxOwner::onFocusChanged(Evas_Object *, void *)
{
	calls.push_back("focus");
}

void FakeBoxOwner::onFavoriteChanged(Evas_Object *, bool state, void *)
{
	calls.push_back(std::string("favorite:") + (state ? "1" : "0"));
}

void FakeBoxOwner::onEntryChanged(Evas_Object *, void *)
{
	calls.push_back("changed");
}

void FakeBoxOwner::onMaxLengthReached(Evas_Object *, void *)
{
	calls.push_back("maxlength");
}

void FakeBoxOwner::onChangeModeRequeted()
{
	calls.push_back("mode");
}

void FakeBoxOwner::onImageSelected(const char *path)
{
	calls.push_back(std::string("image:") + (path ? path : ""));
}

int FakeBoxOwner::onEntryCheckImageCount()
{
	calls.push_back("count");
	return imageCount;
}

void FakeBoxOwner::suspendKeypad()
{
	calls.push_back("suspend");
}

void FakeBoxOwner::resumeKeypad()
{
	calls.push_back("resume");
}

void FakeBoxOwner::onFocusCurrentItem()
{
	calls.push_back("focuscurrent");
}

void FakeBoxOwner::onImagePopupRequested(bool show)
{
	calls.push_back(show ? "popup:1" : "popup:0");
}

void FakeBoxOwner::onCheckGuideText(void *)
{
	calls.push_back("guide");
}

} // namespace memo_ui_test
