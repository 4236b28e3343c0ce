#include "Recorder/MemoMprisPlayer.h"

#include <Eldbus.h>

#include <cstdlib>
#include <cstring>
#include <sys/stat.h>

#include "MemoLog.h"
#include "MiniControllerSupport.h"

namespace
{
const char *const BUS_NAME = "org.mpris.MediaPlayer2.memo";
const char *const OBJECT_PATH = "/org/mpris/MediaPlayer2";
const char *const TRACK_PATH = "/com/veltron/memo/track/voice";
const char *const SELF_KEY = "memo.mpris";
const int REQUEST_PLAY = 1, REQUEST_PAUSE = -1, REQUEST_TOGGLE = 0, REQUEST_STOP = 2;

// A session bus to talk to: named by the environment, or the user's socket. Without either the library would
// try to start one.
bool sessionBusExists()
{
	const char *address = getenv("DBUS_SESSION_BUS_ADDRESS");
	if (address && *address)
		return true;
	const char *runtime = getenv("XDG_RUNTIME_DIR");
	struct stat st;
	return runtime && stat((std::string(runtime) + "/bus").c_str(), &st) == 0 && S_ISSOCK(st.st_mode);
}

void appendVariant(Eldbus_Message_Iter *dict, const char *key, const char *type, const void *value)
{
	Eldbus_Message_Iter *entry = nullptr, *variant = nullptr;
	eldbus_message_iter_arguments_append(dict, "{sv}", &entry);
	eldbus_message_iter_basic_append(entry, 's', key);
	variant = eldbus_message_iter_container_new(entry, 'v', type);
	if (type[0] == 'x')
		eldbus_message_iter_basic_append(variant, 'x', *static_cast<const int64_t *>(value));
	else
		eldbus_message_iter_basic_append(variant, type[0], static_cast<const char *>(value));
	eldbus_message_iter_container_close(entry, variant);
	eldbus_message_iter_container_close(dict, entry);
}
} // namespace

// The two interfaces of the object: the application (org.mpris.MediaPlayer2) and its player.
struct MemoMprisBus {
	static MemoMprisPlayer *self(const Eldbus_Service_Interface *iface)
	{
		return static_cast<MemoMprisPlayer *>(eldbus_service_object_data_get(iface, SELF_KEY));
	}

	static Eldbus_Message *request(const Eldbus_Service_Interface *iface, const Eldbus_Message *msg, int what)
	{
		Eldbus_Message *reply = eldbus_message_method_return_new(msg);
		if (MemoMprisPlayer *player = self(iface))
			player->__request(what);
		return reply;
	}
	static Eldbus_Message *playCb(const Eldbus_Service_Interface *i, const Eldbus_Message *m)
	{
		return request(i, m, REQUEST_PLAY);
	}
	static Eldbus_Message *pauseCb(const Eldbus_Service_Interface *i, const Eldbus_Message *m)
	{
		return request(i, m, REQUEST_PAUSE);
	}
	static Eldbus_Message *playPauseCb(const Eldbus_Service_Interface *i, const Eldbus_Message *m)
	{
		return request(i, m, REQUEST_TOGGLE);
	}
	static Eldbus_Message *stopCb(const Eldbus_Service_Interface *i, const Eldbus_Message *m)
	{
		return request(i, m, REQUEST_STOP);
	}
	// Next, Previous, Seek, SetPosition, OpenUri and Quit do nothing for a single voice memo.
	static Eldbus_Message *ignoredCb(const Eldbus_Service_Interface *, const Eldbus_Message *m)
	{
		return eldbus_message_method_return_new(m);
	}
	static Eldbus_Message *raiseCb(const Eldbus_Service_Interface *, const Eldbus_Message *m)
	{
		mini_controller::resumeApp();
		return eldbus_message_method_return_new(m);
	}

	static Eina_Bool rootPropertyCb(const Eldbus_Service_Interface *, const char *name, Eldbus_Message_Iter *iter,
	                                const Eldbus_Message *, Eldbus_Message **)
	{
		if (!strcmp(name, "Identity"))
			eldbus_message_iter_basic_append(iter, 's', "Memo");
		else if (!strcmp(name, "DesktopEntry"))
			eldbus_message_iter_basic_append(iter, 's', "com.veltron.memo");
		else if (!strcmp(name, "CanRaise"))
			eldbus_message_iter_basic_append(iter, 'b', EINA_TRUE);
		else if (!strcmp(name, "CanQuit") || !strcmp(name, "HasTrackList"))
			eldbus_message_iter_basic_append(iter, 'b', EINA_FALSE);
		else {
			Eldbus_Message_Iter *array = eldbus_message_iter_container_new(iter, 'a', "s");
			eldbus_message_iter_container_close(iter, array);
		}
		return EINA_TRUE;
	}

	static Eina_Bool playerPropertyCb(const Eldbus_Service_Interface *iface, const char *name,
	                                  Eldbus_Message_Iter *iter, const Eldbus_Message *, Eldbus_Message **)
	{
		MemoMprisPlayer *player = self(iface);
		if (!player)
			return EINA_FALSE;
		if (!strcmp(name, "PlaybackStatus")) {
			eldbus_message_iter_basic_append(iter, 's', player->__playbackStatus());
		} else if (!strcmp(name, "Metadata")) {
			Eldbus_Message_Iter *dict = eldbus_message_iter_container_new(iter, 'a', "{sv}");
			appendVariant(dict, "mpris:trackid", "o", TRACK_PATH);
			appendVariant(dict, "xesam:title", "s", player->__title.c_str());
			int duration = 0;
			if (player->__player && player_get_duration(player->__player, &duration) == PLAYER_ERROR_NONE) {
				int64_t us = static_cast<int64_t>(duration) * 1000;
				appendVariant(dict, "mpris:length", "x", &us);
			}
			eldbus_message_iter_container_close(iter, dict);
		} else if (!strcmp(name, "Position")) {
			eldbus_message_iter_basic_append(iter, 'x', static_cast<int64_t>(player->__positionUs()));
		} else if (!strcmp(name, "Rate") || !strcmp(name, "MinimumRate") || !strcmp(name, "MaximumRate") ||
		           !strcmp(name, "Volume")) {
			eldbus_message_iter_basic_append(iter, 'd', 1.0);
		} else {
			// CanPlay, CanPause and CanControl hold; CanGoNext, CanGoPrevious and CanSeek do not.
			const bool can = !strcmp(name, "CanPlay") || !strcmp(name, "CanPause") || !strcmp(name, "CanControl");
			eldbus_message_iter_basic_append(iter, 'b', can ? EINA_TRUE : EINA_FALSE);
		}
		return EINA_TRUE;
	}

	static const Eldbus_Service_Interface_Desc *rootDesc()
	{
		static const Eldbus_Method methods[] = {
		    {"Raise", nullptr, nullptr, raiseCb, 0}, {"Quit", nullptr, nullptr, ignoredCb, 0}, {}};
		static const Eldbus_Property properties[] = {{"CanQuit", "b", nullptr, nullptr, 0},
		                                             {"CanRaise", "b", nullptr, nullptr, 0},
		                                             {"HasTrackList", "b", nullptr, nullptr, 0},
		                                             {"Identity", "s", nullptr, nullptr, 0},
		                                             {"DesktopEntry", "s", nullptr, nullptr, 0},
		                                             {"SupportedUriSchemes", "as", nullptr, nullptr, 0},
		                                             {"SupportedMimeTypes", "as", nullptr, nullptr, 0},
		                                             {}};
		static const Eldbus_Service_Interface_Desc desc = {"org.mpris.MediaPlayer2", methods, nullptr, properties,
		                                                   rootPropertyCb,           nullptr};
		return &desc;
	}

	static const Eldbus_Service_Interface_Desc *playerDesc()
	{
		static const Eldbus_Arg_Info offset[] = {{"x", "Offset"}, {}};
		static const Eldbus_Arg_Info position[] = {{"o", "TrackId"}, {"x", "Position"}, {}};
		static const Eldbus_Arg_Info uri[] = {{"s", "Uri"}, {}};
		static const Eldbus_Method methods[] = {
		    {"Next", nullptr, nullptr, ignoredCb, 0}, {"Previous", nullptr, nullptr, ignoredCb, 0},
		    {"Pause", nullptr, nullptr, pauseCb, 0},  {"PlayPause", nullptr, nullptr, playPauseCb, 0},
		    {"Stop", nullptr, nullptr, stopCb, 0},    {"Play", nullptr, nullptr, playCb, 0},
		    {"Seek", offset, nullptr, ignoredCb, 0},  {"SetPosition", position, nullptr, ignoredCb, 0},
		    {"OpenUri", uri, nullptr, ignoredCb, 0},  {}};
		static const Eldbus_Signal signals[] = {{"Seeked", offset, 0}, {}};
		static const Eldbus_Property properties[] = {
		    {"PlaybackStatus", "s", nullptr, nullptr, 0}, {"Rate", "d", nullptr, nullptr, 0},
		    {"Metadata", "a{sv}", nullptr, nullptr, 0},   {"Volume", "d", nullptr, nullptr, 0},
		    {"Position", "x", nullptr, nullptr, 0},       {"MinimumRate", "d", nullptr, nullptr, 0},
		    {"MaximumRate", "d", nullptr, nullptr, 0},    {"CanGoNext", "b", nullptr, nullptr, 0},
		    {"CanGoPrevious", "b", nullptr, nullptr, 0},  {"CanPlay", "b", nullptr, nullptr, 0},
		    {"CanPause", "b", nullptr, nullptr, 0},       {"CanSeek", "b", nullptr, nullptr, 0},
		    {"CanControl", "b", nullptr, nullptr, 0},     {}};
		static const Eldbus_Service_Interface_Desc desc = {
		    "org.mpris.MediaPlayer2.Player", methods, signals, properties, playerPropertyCb, nullptr};
		return &desc;
	}

	static void nameRequestCb(void *, const Eldbus_Message *msg, Eldbus_Pending *)
	{
		const char *name = nullptr, *text = nullptr;
		unsigned int reply = 0;
		if (eldbus_message_error_get(msg, &name, &text))
			MEMO_LOGI("media controls: %s %s", name, text);
		else if (eldbus_message_arguments_get(msg, "u", &reply) && reply != ELDBUS_NAME_REQUEST_REPLY_PRIMARY_OWNER)
			MEMO_LOGI("media controls: %s belongs to another process", BUS_NAME);
	}
};

MemoMprisPlayer::MemoMprisPlayer(recorder_h recorder, const char *title)
    : __recorder(recorder), __player(nullptr), __title(title ? title : ""), __positionMs(0), __conn(nullptr),
      __rootIface(nullptr), __playerIface(nullptr)
{
}

MemoMprisPlayer::MemoMprisPlayer(player_h player, const char *title)
    : __recorder(nullptr), __player(player), __title(title ? title : ""), __positionMs(0), __conn(nullptr),
      __rootIface(nullptr), __playerIface(nullptr)
{
}

MemoMprisPlayer::~MemoMprisPlayer()
{
	if (!__conn)
		return;
	// Unregistering reads the properties once more; the handles may be gone by then.
	__recorder = nullptr;
	__player = nullptr;
	eldbus_name_release(__conn, BUS_NAME, nullptr, nullptr);
	if (__playerIface)
		eldbus_service_interface_unregister(__playerIface);
	if (__rootIface)
		eldbus_service_interface_unregister(__rootIface);
	eldbus_connection_unref(__conn);
	eldbus_shutdown();
}

bool MemoMprisPlayer::create()
{
	if (__conn)
		return true;
	if (!sessionBusExists()) {
		MEMO_LOGI("no session bus: the desktop's media controls are not offered");
		return false;
	}
	eldbus_init();
	__conn = eldbus_connection_get(ELDBUS_CONNECTION_TYPE_SESSION);
	if (!__conn) {
		MEMO_LOGI("the session bus cannot be reached: the desktop's media controls are not offered");
		eldbus_shutdown();
		return false;
	}
	__rootIface = eldbus_service_interface_register(__conn, OBJECT_PATH, MemoMprisBus::rootDesc());
	__playerIface = eldbus_service_interface_register(__conn, OBJECT_PATH, MemoMprisBus::playerDesc());
	if (!__rootIface || !__playerIface) {
		MEMO_LOGE("cannot register %s", OBJECT_PATH);
		return false;
	}
	eldbus_service_object_data_set(__rootIface, SELF_KEY, this);
	eldbus_service_object_data_set(__playerIface, SELF_KEY, this);
	eldbus_name_request(__conn, BUS_NAME, ELDBUS_NAME_REQUEST_FLAG_DO_NOT_QUEUE, MemoMprisBus::nameRequestCb, nullptr);
	return true;
}

void MemoMprisPlayer::update()
{
	if (__playerIface)
		eldbus_service_property_changed(__playerIface, "PlaybackStatus");
}

void MemoMprisPlayer::setPosition(unsigned long long ms)
{
	__positionMs = ms;
}

void MemoMprisPlayer::setTitle(const char *title)
{
	__title = title ? title : "";
	if (__playerIface)
		eldbus_service_property_changed(__playerIface, "Metadata");
}

const char *MemoMprisPlayer::__playbackStatus() const
{
	int state = 0;
	if (__recorder) {
		recorder_state_e s = RECORDER_STATE_NONE;
		recorder_get_state(__recorder, &s);
		state = s == RECORDER_STATE_RECORDING ? 3 : s == RECORDER_STATE_PAUSED ? 4 : 0;
	} else if (__player) {
		player_state_e s = PLAYER_STATE_NONE;
		player_get_state(__player, &s);
		state = s == PLAYER_STATE_PLAYING ? 3 : s == PLAYER_STATE_PAUSED ? 4 : 0;
	}
	return state == 3 ? "Playing" : state == 4 ? "Paused" : "Stopped";
}

long long MemoMprisPlayer::__positionUs() const
{
	int ms = 0;
	if (__player && player_get_play_position(__player, &ms) == PLAYER_ERROR_NONE)
		return ms * 1000LL;
	return static_cast<long long>(__positionMs) * 1000;
}

void MemoMprisPlayer::__request(int request)
{
	const char *status = __playbackStatus();
	const bool stopped = !strcmp(status, "Stopped");
	if (stopped || (request == REQUEST_PLAY && !strcmp(status, "Playing")) ||
	    (request == REQUEST_PAUSE && !strcmp(status, "Paused")))
		return;
	if (request == REQUEST_STOP)
		_signal.emit(__recorder ? "recorder,stopped" : "player,canceled", nullptr);
	else
		_signal.emit(__recorder ? "recorder,paused" : "player,pausedResumed", nullptr);
}
