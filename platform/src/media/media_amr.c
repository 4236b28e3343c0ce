/* AMR-NB duration from the frame headers. */
#include "media/media_amr.h"

#include <stdio.h>
#include <string.h>

#define AMR_HEADER "#!AMR\n"
#define FRAME_MS 20

int media_amr_duration_ms(const char *path)
{
	/* Bytes after the header byte, by frame type (bits 3 to 6 of the header byte); 15 is "no data". */
	static const int payload[16] = {12, 13, 15, 17, 19, 20, 26, 31, 5, -1, -1, -1, -1, -1, -1, 0};
	FILE *f = path ? fopen(path, "rb") : NULL;
	if (!f)
		return -1;
	char magic[sizeof(AMR_HEADER) - 1];
	long frames = -1;
	if (fread(magic, 1, sizeof(magic), f) == sizeof(magic) && !memcmp(magic, AMR_HEADER, sizeof(magic))) {
		unsigned char buf[65536];
		size_t n, skip = 0;
		frames = 0;
		while (frames >= 0 && (n = fread(buf, 1, sizeof(buf), f)) > 0) {
			size_t pos = skip;
			for (; pos < n; frames++) {
				int size = payload[(buf[pos] >> 3) & 0x0f];
				if (size < 0) {
					frames = -1;
					break;
				}
				pos += 1 + (size_t)size;
			}
			skip = pos - n; /* the rest of a frame that runs into the next block */
			if (frames < 0)
				break;
		}
	}
	fclose(f);
	return frames < 0 ? -1 : (int)(frames * FRAME_MS);
}
