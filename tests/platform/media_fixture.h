// Shared set-up of the media tests: the test microphone and speakers, no call, and a look at the
// recorded files with GStreamer's own discoverer.
#ifndef TESTS_PLATFORM_MEDIA_FIXTURE_H
#define TESTS_PLATFORM_MEDIA_FIXTURE_H

#include <gtest/gtest.h>

#include <Ecore.h>
#include <gst/pbutils/pbutils.h>
#include <recorder.h>
#include <vconf.h>

#include <cstdlib>
#include <string>

#include "TestEnv.h"

class MediaTest : public ::testing::Test
{
protected:
	static void SetUpTestSuite()
	{
		ecore_init();
		setenv("TIZEN_AUDIO_SOURCE", "test", 1);
		setenv("TIZEN_AUDIO_SINK", "fake", 1);
		gst_init(nullptr, nullptr);
	}
	static void TearDownTestSuite() { ecore_shutdown(); }
	void SetUp() override { vconf_set_int(VCONFKEY_CALL_STATE, VCONFKEY_CALL_OFF); }
	void TearDown() override { vconf_set_int(VCONFKEY_CALL_STATE, VCONFKEY_CALL_OFF); }

	// Duration of a sound file in seconds as the discoverer finds it; -1 when it is no sound file.
	static double durationOf(const std::string &path)
	{
		GstDiscoverer *discoverer = gst_discoverer_new(5 * GST_SECOND, nullptr);
		gchar *uri = gst_filename_to_uri(path.c_str(), nullptr);
		GstDiscovererInfo *info = gst_discoverer_discover_uri(discoverer, uri, nullptr);
		double seconds = -1;
		if (info && gst_discoverer_info_get_result(info) == GST_DISCOVERER_OK)
			seconds = gst_discoverer_info_get_duration(info) / (double)GST_SECOND;
		if (info)
			gst_discoverer_info_unref(info);
		g_free(uri);
		g_object_unref(discoverer);
		return seconds;
	}

	// Records at least `ms` of the test tone into path; false when the recorder fails.
	static bool record(const std::string &path, unsigned long long ms)
	{
		recorder_h rec = nullptr;
		unsigned long long elapsed = 0;
		auto statusCb = [](unsigned long long e, unsigned long long, void *d) {
			*static_cast<unsigned long long *>(d) = e;
		};
		bool ok = recorder_create_audiorecorder(&rec) == RECORDER_ERROR_NONE &&
		          recorder_set_filename(rec, path.c_str()) == RECORDER_ERROR_NONE &&
		          recorder_set_recording_status_cb(rec, statusCb, &elapsed) == RECORDER_ERROR_NONE &&
		          recorder_prepare(rec) == RECORDER_ERROR_NONE && recorder_start(rec) == RECORDER_ERROR_NONE &&
		          memo_test::pump(30, [&] { return elapsed >= ms; }) && recorder_commit(rec) == RECORDER_ERROR_NONE &&
		          recorder_unprepare(rec) == RECORDER_ERROR_NONE;
		return recorder_destroy(rec) == RECORDER_ERROR_NONE && ok;
	}
};

#endif
