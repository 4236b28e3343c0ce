#ifndef TESTS_UI_SUPPORT_FAKEBOXOWNER_H
#define TESTS_UI_SUPPORT_FAKEBOXOWNER_H

// A stand-in for the box control in tests of a single box item: it records every request as a short
// string and answers the structural ones the simple way (new items behind the asker, removal merging
// the text into the item before), so that an item's own behaviour can be watched in isolation.

#include <string>
#include <vector>

#include <Elementary.h>

#include "Box/IMemoBoxItemListener.h"
#include "Box/MemoBoxItem.h"

namespace memo_ui_test
{

class FakeBoxOwner : public IMemoBoxItemListener
{
public:
	FakeBoxOwner(Evas_Object *box, const char *memoUuid = "test-memo");
	~FakeBoxOwner() override;

	// Creates an item of `type`, packs it at the end and returns it (owned here).
	MemoBoxItem *addItem(_MemoBoxItemType type, bool editable = true);
	// Removes and deletes an item.
	void removeItem(MemoBoxItem *item);

	std::vector<MemoBoxItem *> items;
	// Requests in order, e.g. "add:1:text", "unpack", "focus", "changed", "mode", "image:/p", "popup:1".
	std::vector<std::string> calls;
	// What onEntryCheckImageCount answers.
	int imageCount = -1;
	// Whether onUnpackRequested removes the item (the only item is never removed).
	bool allowUnpack = true;

	// Number of recorded calls that start with `prefix`.
	int count(const std::string &prefix) const;

	void onUnpackRequested(Evas_Object *entry, void *item) override;
	MemoBoxItem *onAddRequested(Evas_Object *entry, _MemoBoxItemType type, const char *text, void *item) override;
	void onFocusChanged(Evas_Object *entry, void *item) override;
	void onFavoriteChanged(Evas_Object *star, bool state, void *item) override;
	void onEntryChanged(Evas_Object *entry, void *item) override;
	void onMaxLengthReached(Evas_Object *entry, void *item) override;
	void onChangeModeRequeted() override;
	void onImageSelected(const char *path) override;
	int onEntryCheckImageCount() override;
	void suspendKeypad() override;
	void resumeKeypad() override;
	void onFocusCurrentItem() override;
	void onImagePopupRequested(bool show) override;
	void onCheckGuideText(void *item) override;

private:
	Evas_Object *__box;
	std::string __uuid;
};

} // namespace memo_ui_test

#endif
