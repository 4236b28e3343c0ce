#ifndef INC_UTIL_MEMOUTIL_H
#define INC_UTIL_MEMOUTIL_H

#include <time.h>

// Static helpers that ask the platform something. Failures never raise: they end in
// false, 0 or null with an error line. The cached paths are filled on first use without
// a lock: fill them on the main loop first.
class MemoUtil
{
public:
	// ---- Environment queries (MemoUtil.cpp, MemoUtilDevice.cpp) ----

	// Makes a new canonical 36-character UUID text in *out; the caller frees it with free().
	// Logs "Malloc Error" and returns false when it cannot allocate.
	static bool createUUIDN(char **out);

	// The resource folder (trailing "/"); cached, never null.
	static const char *getResourcePath();
	// The theme file "edje/memo.edj" found through the resource manager; cached.
	static const char *getEdjePath();
	// The resource folder + "images/"; cached (shared with getImageResourcePathN).
	static const char *getImagePath();
	// The app's data folder (trailing "/"); cached, never null.
	static const char *getDataPath();
	// New string: data folder + name; null on a null name. Caller frees.
	static char *getDataFilePathN(const char *name);
	// New string: images folder + name; null if neither is known. Caller frees.
	static char *getImageResourcePathN(const char *name);
	// New string: the localised date and time of seconds since the epoch, in the
	// region format and 12/24 hour clock of the device. Caller frees.
	static char *getDateTimeTextN(time_t seconds);

	// Non-zero when power saving is on ("db/setting/psmode"; 2 is reported as 1).
	static int isPowerSavingMode();
	// Plays the tap feedback pattern.
	static void playTapFeedback();
	// True when the sync account is signed in; asks the account service each time.
	static bool checkVeltronAccountLogIn();
	// True when a call is ringing or on.
	static bool getCallStatus();
	// True when internal storage has strictly more than 105 MiB free.
	static bool getMemorySpaceStatusGet();
	// True when the quick memo feature is on.
	static bool isQuickMemoFeatureEnabled();
	// True when any recorder is recording.
	static bool isRecorderBusy();
	// True on the sales code "KTC".
	static bool isSalesCodeKTC();

	// ---- Text that enters the system (MemoUtilText.cpp) ----

	// A copy of `text` that every stored document can carry: control characters other than tab and
	// newline, U+FFFE, U+FFFF and bytes that are not UTF-8 are dropped; CR LF and a lone CR become
	// a newline. For text from outside (a share,
	// a quick memo append) and from the keyboard or a paste. Null for a null text; the caller frees.
	static char *stripControlCharsN(const char *text);

	// ---- Image processing (MemoUtilImage.cpp) ----
	// resizeImageJpg, resizeImagePng, getOrient and rotateImage use no shared state and may run on
	// any thread. getInsertImageSize and resizeImage use an Evas canvas; called off the main loop they
	// run that part on the main loop and wait for it (the main loop must be running).

	// Shrinks the JPEG srcPath into dstPath (may be the same path) to fit width x height: the
	// larger value goes to the picture's longer side, both swapped for a square picture. The
	// decoder already scales down by 1/2, 1/4 or 1/8 when scale is below 0.5, 0.25 or 0.125.
	// Encodes at quality 100. False only when the source is missing or cannot be decoded; later
	// failures are logged and still give true.
	static bool resizeImageJpg(const char *srcPath, const char *dstPath, int width, int height, float scale);
	static bool resizeImageJpg(const char *srcPath, const char *dstPath, int width, int height);
	// Stretches the PNG srcPath to width x height into the PNG dstPath (may be the same path), as
	// resizeImage's mode 2 does but without a canvas, so that a worker shrinks a picture wholly off the
	// main loop; the pixels are the canvas's to within two levels. False when the source is missing, not
	// a readable PNG or of 9000000 pixels or more, or a size is not positive; a failed save is logged
	// ("Resizing failed."), leaves no target, and still gives true.
	static bool resizeImagePng(const char *srcPath, const char *dstPath, int width, int height);
	// Renders srcPath into dstPath (the format follows dstPath's extension) through a buffer
	// canvas of width x height. cropMode 0 fits the height and centres, 1 makes the canvas as wide
	// as the picture at that height, 2 stretches, 3 crops to the box's proportions (top rows of a
	// tall picture, the middle of a wide one) and scales; other modes draw nothing. False only when
	// no canvas or no rendered pixels could be had: a source that cannot be read renders an empty
	// (transparent) canvas, sizes below 1 become 1, and a failed save is logged ("Resizing
	// failed.") and still gives true.
	static bool resizeImage(const char *srcPath, const char *dstPath, int width, int height, int cropMode);
	// The EXIF orientation (1 to 8) of the file, or 0 without a readable tag.
	static int getOrient(const char *path);
	// Turns the ".jpg" file at path upright in place for the EXIF orientation: only 3, 6 and 8
	// turn; every other value re-encodes the picture as it is. Other names are left alone.
	static void rotateImage(const char *path, int orientation);
	// The image_util_rotation_e value for an EXIF orientation: 3 -> 180, 6 -> 90, 8 -> 270
	// (clockwise), anything else none.
	static int rotationTypeForOrientation(int orientation);
	// Reads the picture's size without decoding it and says whether it must be shrunk (a side
	// above 4000 or more than 320000 pixels). When it must: true, *width and *height the even
	// target size, *scale (if given) the factor used. *error gets the Evas load error, or -1
	// when the resolution is refused (JPEG 225000000 pixels, other 9000000, or more); then false.
	// A missing file gives false with all outs untouched.
	static bool getInsertImageSize(const char *path, int *width, int *height, int *error, float *scale);
	static bool getInsertImageSize(const char *path, int *width, int *height, int *error);

private:
	// True when width x height stays below the limit for the file's type; logs the refusal.
	static bool __getcheckImageAvailableResolution(const char *path, int width, int height);

public:
	// ---- end of image processing ----

private:
	MemoUtil() = delete;
};

#endif
