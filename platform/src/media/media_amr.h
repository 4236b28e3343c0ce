/* AMR-NB files ("#!AMR\n", then frames of 20 ms): their parser tells no duration, and the
   discoverer takes tens of milliseconds to find it. */
#ifndef PLATFORM_SRC_MEDIA_MEDIA_AMR_H
#define PLATFORM_SRC_MEDIA_MEDIA_AMR_H

/* The duration of the AMR-NB file at path in milliseconds, counted from its frame headers; -1 when
   it is not one. */
int media_amr_duration_ms(const char *path);

#endif
