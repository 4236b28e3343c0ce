// The sound route that follows the earjack, and the media keys of the app's window.
#include <gtest/gtest.h>

#include <Ecore.h>
#include <Elementary.h>
#include <media_key.h>
#include <sound_manager_product.h>
#include <vconf.h>

#include <string>
#include <vector>

#include "TestEnv.h"

namespace
{
using Events = std::vector<std::string>;

void deviceCb(sound_device_in_e in, sound_device_out_e out, void *data)
{
	static_cast<Events *>(data)->push_back(std::to_string(in) + "/" + std::to_string(out));
}

void keyCb(media_key_e key, media_key_event_e status, void *data)
{
	static_cast<Events *>(data)->push_back(std::to_string(key) + (status == MEDIA_KEY_STATUS_PRESSED ? "v" : "^"));
}
} // namespace

TEST(SoundRoute, FollowsTheEarjackAndReportsItsChanges)
{
	ecore_init();
	vconf_set_int(VCONFKEY_SYSMAN_EARJACK, VCONFKEY_SYSMAN_EARJACK_REMOVED);
	sound_device_in_e in = SOUND_DEVICE_IN_BT_SCO;
	ASSERT_EQ(SOUND_MANAGER_ERROR_NONE, sound_manager_get_active_route(nullptr, &in));
	EXPECT_EQ(SOUND_DEVICE_IN_MIC, in);

	Events events;
	ASSERT_EQ(SOUND_MANAGER_ERROR_NONE, sound_manager_set_active_device_changed_cb(deviceCb, &events));
	vconf_set_int(VCONFKEY_SYSMAN_EARJACK, VCONFKEY_SYSMAN_EARJACK_4WIRE);
	ASSERT_TRUE(memo_test::pump(5, [&] { return events.size() == 1; }));
	vconf_set_int(VCONFKEY_SYSMAN_EARJACK, VCONFKEY_SYSMAN_EARJACK_3WIRE);
	ASSERT_TRUE(memo_test::pump(5, [&] { return events.size() == 2; }));
	const std::string wiredOut = std::to_string(SOUND_DEVICE_OUT_WIRED_ACCESSORY);
	EXPECT_EQ((Events{std::to_string(SOUND_DEVICE_IN_WIRED_ACCESSORY) + "/" + wiredOut,
	                  std::to_string(SOUND_DEVICE_IN_MIC) + "/" + wiredOut}),
	          events);
	sound_device_out_e out = SOUND_DEVICE_OUT_SPEAKER;
	ASSERT_EQ(SOUND_MANAGER_ERROR_NONE, sound_manager_get_active_route(&out, nullptr));
	EXPECT_EQ(SOUND_DEVICE_OUT_WIRED_ACCESSORY, out);

	sound_manager_unset_active_device_changed_cb();
	vconf_set_int(VCONFKEY_SYSMAN_EARJACK, VCONFKEY_SYSMAN_EARJACK_REMOVED);
	memo_test::pumpFor(0.3);
	EXPECT_EQ(2u, events.size());
	ecore_shutdown();
}

TEST(MediaKeys, ReachTheReserverUntilReleased)
{
	Events events;
	EXPECT_EQ(MEDIA_KEY_ERROR_OPERATION_FAILED, media_key_reserve(keyCb, &events));
	Evas_Object *win = memo_test::addShownWindow("media-keys");
	Evas *evas = evas_object_evas_get(win);
	auto press = [&](const char *key) {
		evas_event_feed_key_down(evas, key, key, "", nullptr, 0, nullptr);
		evas_event_feed_key_up(evas, key, key, "", nullptr, 0, nullptr);
	};
	ASSERT_EQ(MEDIA_KEY_ERROR_NONE, media_key_reserve(keyCb, &events));
	press("XF86AudioPlay");
	press("XF86AudioMedia");
	press("XF86AudioNext");
	press("Return");
	EXPECT_EQ((Events{"0v", "0^", "8v", "8^", "4v", "4^"}), events);
	ASSERT_EQ(MEDIA_KEY_ERROR_NONE, media_key_release());
	press("XF86AudioPlay");
	EXPECT_EQ(6u, events.size());
	evas_object_del(win);
}
