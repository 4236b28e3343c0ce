/* One picture from a camera through GStreamer, taken off the main loop. */
#ifndef COMPANIONS_CAMERA_CAMERA_SHOT_H
#define COMPANIONS_CAMERA_CAMERA_SHOT_H

#include <stdbool.h>

/* Set to 1, the camera takes its pictures from GStreamer's test pattern instead of a V4L2 device. */
#define CAMERA_TEST_SOURCE_ENV "COMPANION_CAMERA_TEST_SOURCE"
/* The V4L2 device to use; by default the first /dev/video<n> there is. */
#define CAMERA_DEVICE_ENV "COMPANION_CAMERA_DEVICE"

typedef struct {
	int width;
	int height;
	char *device; /* NULL: the test source */
	char *path;   /* the JPEG to write */
	char *error;  /* set when the picture could not be taken (malloc'ed) */
} camera_shot_s;

/* The camera device to use (malloc'ed), or NULL when there is none. */
char *camera_shot_device_find(void);
/* Width and height of a "RESOLUTION" value: "VGA", "QVGA", "SVGA", "XGA", "HD", "FHD" or "<w>x<h>";
   false for anything else. */
bool camera_shot_resolution_parse(const char *text, int *width, int *height);
/* Takes the picture, blocking (for a worker thread): true when shot->path holds a JPEG of the size. */
bool camera_shot_take(camera_shot_s *shot);

#endif /* COMPANIONS_CAMERA_CAMERA_SHOT_H */
