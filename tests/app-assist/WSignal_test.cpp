// Emission semantics of WSignal: order, changes during an emission, owners, teardown.
#include <functional>
#include <string>
#include <vector>

#include "WSignal.h"
#include "support/AppAssistFixture.h"

using app_assist::WSignal;
using Signal = WSignal<void(const char *, void *)>;

namespace
{

class WSignalTest : public aa_test::UiTest
{
protected:
	Evas_Object *makeOwner() { return evas_object_rectangle_add(evas_object_evas_get(window->getEvasObj())); }
	std::vector<std::string> heard;
};

TEST_F(WSignalTest, DeliversInRegistrationOrderWithArguments)
{
	Signal signal;
	int payload = 7;
	for (const char *name : {"a", "b", "c"})
		signal.addListener([this, name, &payload](const char *key, void *data) {
			heard.push_back(std::string(name) + ":" + key);
			EXPECT_EQ(data, &payload);
		});
	signal.emit("k", &payload);
	EXPECT_EQ(heard, (std::vector<std::string>{"a:k", "b:k", "c:k"}));
}

// A listener removed during an emission, itself or one still to come, is not called again.
TEST_F(WSignalTest, RemovalDuringEmission)
{
	Signal signal;
	unsigned int selfId = 0, laterId = 0;
	selfId = signal.addListener([&](const char *, void *) {
		heard.push_back("self");
		signal.removeListener(selfId);
		signal.removeListener(laterId);
	});
	signal.addListener([&](const char *, void *) { heard.push_back("other"); });
	laterId = signal.addListener([&](const char *, void *) { heard.push_back("later"); });
	signal.emit("k", nullptr);
	signal.emit("k", nullptr);
	EXPECT_EQ(heard, (std::vector<std::string>{"self", "other", "other"}));
	EXPECT_EQ(signal.getListenerCount(), 1u);
	signal.removeListener(selfId); // logs, changes nothing
	EXPECT_EQ(signal.getListenerCount(), 1u);
}

TEST_F(WSignalTest, ListenerAddedDuringEmissionHearsOnlyLaterOnes)
{
	Signal signal;
	bool added = false;
	signal.addListener([&](const char *key, void *) {
		heard.push_back(std::string("first:") + key);
		if (!added) {
			added = true;
			signal.addListener([&](const char *k, void *) { heard.push_back(std::string("new:") + k); });
		}
	});
	signal.addListener([&](const char *key, void *) { heard.push_back(std::string("second:") + key); });
	signal.emit("one", nullptr);
	EXPECT_EQ(heard, (std::vector<std::string>{"first:one", "second:one"}));
	heard.clear();
	signal.emit("two", nullptr);
	EXPECT_EQ(heard, (std::vector<std::string>{"first:two", "second:two", "new:two"}));
}

// An owner deleted between emissions or during one takes its listener along.
TEST_F(WSignalTest, OwnerDeletionDropsTheListener)
{
	Signal signal;
	Evas_Object *owner = makeOwner(), *dying = makeOwner();
	signal.addListener([&](const char *, void *) { heard.push_back("owned"); }, owner);
	signal.addListener([&](const char *, void *) {
		heard.push_back("free");
		evas_object_del(dying);
	});
	signal.addListener([&](const char *, void *) { heard.push_back("dying"); }, dying);
	evas_object_del(owner);
	EXPECT_EQ(signal.getListenerCount(), 2u);
	signal.emit("k", nullptr);
	EXPECT_EQ(heard, (std::vector<std::string>{"free"}));
	EXPECT_EQ(signal.getListenerCount(), 1u);
}

TEST_F(WSignalTest, OwnerOfAPendingListenerDeletedBeforeItJoins)
{
	Signal signal;
	Evas_Object *owner = makeOwner();
	signal.addListener([&](const char *, void *) {
		if (heard.empty())
			signal.addListener([&](const char *, void *) { heard.push_back("pending"); }, owner);
		heard.push_back("adder");
		evas_object_del(owner);
	});
	signal.emit("k", nullptr);
	signal.emit("k", nullptr);
	EXPECT_EQ(heard, (std::vector<std::string>{"adder", "adder"}));
}

TEST_F(WSignalTest, OwnersOutliveTheSignal)
{
	Evas_Object *owner = makeOwner();
	{
		Signal signal;
		signal.addListener([](const char *, void *) {}, owner);
		signal.addListener([](const char *, void *) {}, owner);
	}
	// The signal removed its delete callbacks; deleting the owner now must not reach it.
	evas_object_del(owner);
	SUCCEED();
}

TEST_F(WSignalTest, ListenerMayDeleteTheSignal)
{
	Signal *signal = new Signal();
	signal->addListener([&](const char *, void *) {
		heard.push_back("deleter");
		delete signal;
	});
	signal->addListener([&](const char *, void *) { heard.push_back("after"); });
	signal->emit("k", nullptr);
	EXPECT_EQ(heard, (std::vector<std::string>{"deleter"}));
}

TEST_F(WSignalTest, EmptyFunctionThrowsAndTheSignalStaysUsable)
{
	Signal signal;
	unsigned int emptyId = signal.addListener(Signal::Listener());
	EXPECT_THROW(signal.emit("k", nullptr), std::bad_function_call);
	signal.removeListener(emptyId);
	signal.addListener([&](const char *, void *) { heard.push_back("late"); });
	signal.emit("k", nullptr);
	EXPECT_EQ(heard, (std::vector<std::string>{"late"}));
}

} // namespace
