// Emission semantics of WSignal: order, changes during an emission, owners, teardown.
#include <functional>
#include <string>
#include <vector>

#include "WSignal.h"
#include "support/AppAssistFixture.h"

using app_assist::WSignal;
using Signal = WSignal<void(const char *, void *)>;
using Heard = std::vector<std::string>;

namespace
{

class WSignalTest : public aa_test::UiTest
{
protected:
	Evas_Object *makeOwner() { return evas_object_rectangle_add(evas_object_evas_get(window->getEvasObj())); }
	// A listener that notes its name and the key.
	Signal::Listener note(const char *name)
	{
		return [this, name](const char *key, void *) { heard.push_back(std::string(name) + ":" + key); };
	}
	Heard heard;
};

TEST_F(WSignalTest, DeliversInRegistrationOrderAndAnEmptyFunctionThrows)
{
	Signal signal;
	int payload = 7;
	signal.addListener([&](const char *, void *data) { EXPECT_EQ(data, &payload); });
	for (const char *name : {"a", "b", "c"})
		signal.addListener(note(name));
	signal.emit("k", &payload);
	EXPECT_EQ(heard, (Heard{"a:k", "b:k", "c:k"}));

	unsigned int emptyId = signal.addListener(Signal::Listener());
	EXPECT_THROW(signal.emit("k", &payload), std::bad_function_call);
	signal.removeListener(emptyId);
	heard.clear();
	signal.emit("again", &payload);
	EXPECT_EQ(heard, (Heard{"a:again", "b:again", "c:again"}));
}

// A listener removed during an emission, itself or one still to come, is not called again; one added
// hears only later emissions; a listener may delete the signal.
TEST_F(WSignalTest, ChangesDuringAnEmission)
{
	Signal signal;
	unsigned int selfId = 0, laterId = 0;
	selfId = signal.addListener([&](const char *key, void *) {
		note("self")(key, nullptr);
		signal.removeListener(selfId);
		signal.removeListener(laterId);
		signal.addListener(note("new"));
	});
	signal.addListener(note("other"));
	laterId = signal.addListener(note("later"));
	signal.emit("one", nullptr);
	signal.emit("two", nullptr);
	EXPECT_EQ(heard, (Heard{"self:one", "other:one", "other:two", "new:two"}));
	EXPECT_EQ(signal.getListenerCount(), 2u);
	signal.removeListener(selfId); // logs, changes nothing
	EXPECT_EQ(signal.getListenerCount(), 2u);

	heard.clear();
	Signal *doomed = new Signal();
	doomed->addListener([&](const char *key, void *) {
		note("deleter")(key, nullptr);
		delete doomed;
	});
	doomed->addListener(note("after"));
	doomed->emit("k", nullptr);
	EXPECT_EQ(heard, (Heard{"deleter:k"}));
}

// An owner deleted between emissions or during one takes its listener along, also one not yet joined;
// owners may outlive the signal.
TEST_F(WSignalTest, OwnerDeletionDropsTheListener)
{
	Signal signal;
	Evas_Object *owner = makeOwner(), *dying = makeOwner(), *pendingOwner = makeOwner();
	signal.addListener(note("owned"), owner);
	signal.addListener([&](const char *key, void *) {
		note("free")(key, nullptr);
		if (dying) {
			signal.addListener(note("pending"), pendingOwner);
			evas_object_del(pendingOwner);
			evas_object_del(dying);
			dying = nullptr;
		}
	});
	signal.addListener(note("dying"), dying);
	evas_object_del(owner);
	EXPECT_EQ(signal.getListenerCount(), 2u);
	signal.emit("k", nullptr);
	signal.emit("k", nullptr);
	EXPECT_EQ(heard, (Heard{"free:k", "free:k"}));
	EXPECT_EQ(signal.getListenerCount(), 1u);

	Evas_Object *survivor = makeOwner();
	{
		Signal shortLived;
		shortLived.addListener(note("x"), survivor);
		shortLived.addListener(note("y"), survivor);
	}
	// The signal removed its delete callbacks; deleting the owner now must not reach it.
	evas_object_del(survivor);
}

} // namespace
