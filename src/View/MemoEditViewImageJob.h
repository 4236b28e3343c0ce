#ifndef SRC_VIEW_MEMOEDITVIEWIMAGEJOB_H
#define SRC_VIEW_MEMOEDITVIEWIMAGEJOB_H

// The work one image worker of the edit view does, with its own copy of what it needs: the view may go while
// the worker runs, and then `view` is cleared and the job ends without it.

#include <string>

#include <Ecore.h>
#include <Eina.h>
#include <app_control.h>

class MemoEditView;

struct MemoEditViewImageJob {
	MemoEditView *view = nullptr;
	Ecore_Thread *thread = nullptr;
	// One picture to shrink in place (the gallery, the camera, a launch).
	std::string path;
	int width = 0;
	int height = 0;
	float scale = 1.0f;
	// The attach panel's pick: its result, the memo's media folder, and the copies made (owned strings).
	app_control_h result = nullptr;
	std::string mediaPath;
	Eina_List *copies = nullptr;

	~MemoEditViewImageJob()
	{
		if (result)
			app_control_destroy(result);
		void *copy = nullptr;
		EINA_LIST_FREE(copies, copy)
		free(copy);
	}
};

// Shrinks and turns upright one copied picture in place: JPEG by its decoder, PNG without a canvas, the rest
// through a canvas. Any thread.
void memoEditViewShrinkPicture(const std::string &path, int width, int height, float scale);

#endif
