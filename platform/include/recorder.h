#ifndef __TIZEN_MULTIMEDIA_RECORDER_H__
#define __TIZEN_MULTIMEDIA_RECORDER_H__

/* The audio recorder: records the microphone into a file. Every callback runs on the main loop.
   States: CREATED -prepare-> READY -start-> RECORDING <-pause/start-> PAUSED; commit and cancel go
   back to READY, unprepare to CREATED. Any other move gives RECORDER_ERROR_INVALID_STATE. */
#include <tizen.h>

#ifdef __cplusplus
extern "C" {
#endif

#define RECORDER_ERROR_CLASS TIZEN_ERROR_RECORDER | 0x10

typedef struct recorder_s *recorder_h;

typedef enum {
	RECORDER_ERROR_NONE = TIZEN_ERROR_NONE,
	RECORDER_ERROR_INVALID_PARAMETER = TIZEN_ERROR_INVALID_PARAMETER,
	RECORDER_ERROR_INVALID_STATE = RECORDER_ERROR_CLASS | 0x02,
	RECORDER_ERROR_OUT_OF_MEMORY = TIZEN_ERROR_OUT_OF_MEMORY,
	RECORDER_ERROR_DEVICE = RECORDER_ERROR_CLASS | 0x04,
	RECORDER_ERROR_INVALID_OPERATION = TIZEN_ERROR_INVALID_OPERATION,
	RECORDER_ERROR_SOUND_POLICY = RECORDER_ERROR_CLASS | 0x06,
	RECORDER_ERROR_SECURITY_RESTRICTED = RECORDER_ERROR_CLASS | 0x07,
	RECORDER_ERROR_SOUND_POLICY_BY_CALL = RECORDER_ERROR_CLASS | 0x08,
	RECORDER_ERROR_SOUND_POLICY_BY_ALARM = RECORDER_ERROR_CLASS | 0x09,
	RECORDER_ERROR_ESD = RECORDER_ERROR_CLASS | 0x0a,
	RECORDER_ERROR_OUT_OF_STORAGE = RECORDER_ERROR_CLASS | 0x0b,
	RECORDER_ERROR_PERMISSION_DENIED = TIZEN_ERROR_PERMISSION_DENIED,
	RECORDER_ERROR_NOT_SUPPORTED = TIZEN_ERROR_NOT_SUPPORTED,
} recorder_error_e;

typedef enum {
	RECORDER_STATE_NONE,
	RECORDER_STATE_CREATED,
	RECORDER_STATE_READY,
	RECORDER_STATE_RECORDING,
	RECORDER_STATE_PAUSED,
} recorder_state_e;

typedef enum {
	RECORDER_RECORDING_LIMIT_TIME,
	RECORDER_RECORDING_LIMIT_SIZE,
	RECORDER_RECORDING_LIMIT_FREE_SPACE,
} recorder_recording_limit_type_e;

typedef enum {
	RECORDER_FILE_FORMAT_3GP,
	RECORDER_FILE_FORMAT_MP4,
	RECORDER_FILE_FORMAT_AMR,
	RECORDER_FILE_FORMAT_ADTS,
	RECORDER_FILE_FORMAT_WAV,
	RECORDER_FILE_FORMAT_OGG,
} recorder_file_format_e;

typedef enum {
	RECORDER_AUDIO_CODEC_DISABLE = -1,
	RECORDER_AUDIO_CODEC_AMR = 0,
	RECORDER_AUDIO_CODEC_AAC,
	RECORDER_AUDIO_CODEC_VORBIS,
	RECORDER_AUDIO_CODEC_PCM,
} recorder_audio_codec_e;

/* Elapsed time in milliseconds (pauses excluded) and file size in kilobytes, about ten times a second
   while recording. */
typedef void (*recorder_recording_status_cb)(unsigned long long elapsed_time, unsigned long long file_size,
                                             void *user_data);
/* A limit was reached: later sound is dropped, the state stays, and the owner commits. */
typedef void (*recorder_recording_limit_reached_cb)(recorder_recording_limit_type_e type, void *user_data);
/* by_policy: the platform made the change (a call took the sound), not a call of the owner. */
typedef void (*recorder_state_changed_cb)(recorder_state_e previous, recorder_state_e current, bool by_policy,
                                          void *user_data);
typedef void (*recorder_error_cb)(recorder_error_e error, recorder_state_e current_state, void *user_data);

int recorder_create_audiorecorder(recorder_h *recorder);
/* Only in RECORDER_STATE_CREATED. */
int recorder_destroy(recorder_h recorder);
int recorder_prepare(recorder_h recorder);
int recorder_unprepare(recorder_h recorder);
/* From READY starts a new file, from PAUSED resumes it. */
int recorder_start(recorder_h recorder);
int recorder_pause(recorder_h recorder);
/* Finishes the file and keeps it. */
int recorder_commit(recorder_h recorder);
/* Stops and removes the file. */
int recorder_cancel(recorder_h recorder);
int recorder_get_state(recorder_h recorder, recorder_state_e *state);

/* The settings below need CREATED or READY. */
int recorder_set_filename(recorder_h recorder, const char *path);
/* Caller frees *path. */
int recorder_get_filename(recorder_h recorder, char **path);
int recorder_set_file_format(recorder_h recorder, recorder_file_format_e format);
int recorder_set_audio_encoder(recorder_h recorder, recorder_audio_codec_e codec);
int recorder_attr_set_audio_samplerate(recorder_h recorder, int samplerate);
/* Bits per second; AMR takes its nearest mode at or below, from 4750 to 12200. */
int recorder_attr_set_audio_encoder_bitrate(recorder_h recorder, int bitrate);
/* 0 = no limit. */
int recorder_attr_set_time_limit(recorder_h recorder, int second);
int recorder_attr_set_size_limit(recorder_h recorder, int kbyte);

int recorder_set_recording_status_cb(recorder_h recorder, recorder_recording_status_cb callback, void *user_data);
int recorder_unset_recording_status_cb(recorder_h recorder);
int recorder_set_recording_limit_reached_cb(recorder_h recorder, recorder_recording_limit_reached_cb callback,
                                            void *user_data);
int recorder_unset_recording_limit_reached_cb(recorder_h recorder);
int recorder_set_state_changed_cb(recorder_h recorder, recorder_state_changed_cb callback, void *user_data);
int recorder_unset_state_changed_cb(recorder_h recorder);
int recorder_set_error_cb(recorder_h recorder, recorder_error_cb callback, void *user_data);
int recorder_unset_error_cb(recorder_h recorder);

#ifdef __cplusplus
}
#endif

#endif /* __TIZEN_MULTIMEDIA_RECORDER_H__ */
