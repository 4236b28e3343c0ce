/* The recording pipeline of one recorder: microphone to an AMR-NB file.
   <source> ! audioconvert ! audioresample ! 8 kHz mono S16LE ! amrnbenc ! filesink (appending after
   the "#!AMR\n" header written first). A probe before the file counts what is written and drops the
   sound past a time or size limit. */
#ifndef PLATFORM_SRC_MEDIA_RECORDER_PIPELINE_H
#define PLATFORM_SRC_MEDIA_RECORDER_PIPELINE_H

#include <recorder.h>

typedef struct recorder_pipeline_s recorder_pipeline_t;

/* On the main loop: a limit was reached (error RECORDER_ERROR_NONE), or the pipeline failed
   (limit unused). */
typedef void (*recorder_pipeline_event_cb)(recorder_recording_limit_type_e limit, recorder_error_e error, void *data);

/* A pipeline opened up to the microphone; NULL with *error set. */
recorder_pipeline_t *recorder_pipeline_new(int bitrate, recorder_pipeline_event_cb cb, void *data,
                                           recorder_error_e *error);
void recorder_pipeline_free(recorder_pipeline_t *p);

/* Writes the header into path (truncated) and starts recording; limits of 0 are none. */
recorder_error_e recorder_pipeline_start(recorder_pipeline_t *p, const char *path, int time_limit_s, int size_limit_kb);
recorder_error_e recorder_pipeline_pause(recorder_pipeline_t *p);
recorder_error_e recorder_pipeline_resume(recorder_pipeline_t *p);
/* Ends the file: kept complete, or removed. The pipeline is ready for the next start. */
void recorder_pipeline_finish(recorder_pipeline_t *p, bool keep);

/* Sound written so far, in milliseconds, and the file's size in bytes. */
void recorder_pipeline_progress(recorder_pipeline_t *p, unsigned long long *ms, unsigned long long *bytes);

#endif
