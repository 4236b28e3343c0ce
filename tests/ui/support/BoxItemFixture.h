#ifndef TESTS_UI_SUPPORT_BOXITEMFIXTURE_H
#define TESTS_UI_SUPPORT_BOXITEMFIXTURE_H

// The window of UiFixture with a FakeBoxOwner on its box, for tests of single box items.

#include <string>

#include "FakeBoxOwner.h"
#include "UiTestSupport.h"

namespace memo_ui_test
{

class BoxItemFixture : public UiFixture
{
protected:
	void SetUp() override
	{
		UiFixture::SetUp();
		owner = new FakeBoxOwner(box);
	}
	void TearDown() override
	{
		delete owner;
		UiFixture::TearDown();
	}

	// The markup of an item's entry, "" when it has none.
	static std::string text(MemoBoxItem *item)
	{
		const char *t = elm_entry_entry_get(item->getEntry());
		return t ? t : "";
	}

	FakeBoxOwner *owner = nullptr;
};

} // namespace memo_ui_test

#endif
