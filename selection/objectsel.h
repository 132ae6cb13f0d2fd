// The selection session: the flat API that the app's strokes arrive at.
//
// One session per process: one engine, the brush settings it is built from, and two rectangles, all
// in the globals below. Nothing is re-entrant; call from one thread at a time. Photo and mask
// belong to the caller and are never kept.
//
//   photo   width * height pixels 0xAARRGGBB, rows `width` apart
//   mask    width * height bytes, rows `width` apart; 1 is selected, any other value is not
//
// Pointers and buffer lengths are never checked, sizes and coordinates only where it says so.
#pragma once

#include "selection/ze_rect.h"
#include "support/ze_api.h"

#ifdef __cplusplus
#include "selection/ER_selection.h"
#else
typedef struct ER_selection ER_selection;  // a class of C++; C can hand it on and compare with null
#endif

ZE_BEGIN_FLAT

// The engine, or null before the first init or brush change and after ze_destroy_objectsel.
ZE_API extern ER_selection* g_ERBrush;

// Box of the selected object. Strokes that add widen it; strokes that remove leave it to
// ze_update_objectROI or the erasing pass. {0, 0, 0, 0} before any call.
ZE_API extern ze_rect g_object_boundary;

// Deliberate: kept for the Java side's reset_fill_ROI; nothing in the library reads it.
ZE_API extern ze_rect g_fill_boundary;

// What the next engine is built from; they outlive every engine.
ZE_API extern int g_Brush_Radius;  // pixels, 10 at first
ZE_API extern int g_Brush_Center;  // radius of the core in pixels, 1 at first

// Starts selecting on an image: a new engine from the brush globals, and an empty object box.
// Returns 1, also when the engine's memory could not be had; strokes then do nothing.
ZE_API int ze_init_objectsel(int width, int height);

// Releases the engine. Brush globals and rectangles stay.
ZE_API void ze_destroy_objectsel(void);

// Clears width * height bytes of the mask and empties the object box. Bad input (no mask, a size
// below 1) is logged and changes nothing.
ZE_API void ze_reset_objectsel(unsigned char* mask, int width, int height);

// Deliberate: does nothing; an entry point that the app calls.
ZE_API void ze_reinit_objectsel(unsigned char* mask, int width, int height, ze_rect roi);

// Sets the brush globals and builds a new engine from them, whether there was one or not and
// whether the values changed or not. Any values are taken; see ER_selection::initial.
ZE_API void ze_set_brush_size(int radius, int center);

// One point of a brush stroke, or one segment of a lasso.
//
//   pixels  the photo; used by modes 0 and 1
//   x1, y1  the point, or the segment's start
//   x2, y2  the segment's end; used by modes 4 and 5
//   rect    out: first {width, 0, height, 0}, then widened over what the stroke touched; all that
//           happens without an engine or with an unknown mode
//   fill    1 exactly: then also runs the mode's pass over the object box
//
//   mode  stroke                                 object box        pass
//   0     grows along the photo's edges          widened by rect   fills holes, widens rect
//   1     shrinks along the photo's edges        stays             keeps the largest region, widens
//                                                                  rect and rebuilds the object box
//   2     paints the brush                       widened by rect   fills holes, widens rect
//   3     erases the brush                       stays             none
//   4     draws a segment of an adding lasso     widened by rect   selects what it encloses
//   5     draws a segment of a removing lasso    widened by rect   clears what it encloses
//
// The object box is widened before the pass and not again after it. Deliberate: mode 5 widens it
// although it removes pixels.
ZE_API void ze_modify_objectsel(int* pixels, unsigned char* mask, int width, int height, int x1,
                                int y1, int x2, int y2, int mode, ze_rect* rect, int fill);

// Makes 1 of every byte that is not 1, and 0 of every 1; the object box becomes that of the new
// selection, or {width - 1, 0, height - 1, 0} when nothing is selected.
ZE_API void ze_inverse_mask(unsigned char* mask, int width, int height);

// Stores the object box as it is: unordered and beyond the image too.
ZE_API void ze_set_objectROI(ze_rect roi);
ZE_API ze_rect ze_get_objectROI(void);

// Shrinks the object box to the selected pixels inside it, or to {width, 0, height, 0} when there
// are none.
//
// Deliberate: never looks outside the old box, which only strokes widen. Right after
// ze_init_objectsel the old box is empty and so is the new one, whatever the mask holds.
ZE_API void ze_update_objectROI(unsigned char* mask, int width, int height);

// Sets g_fill_boundary to {width - 1, 0, height - 1, 0}.
ZE_API void ze_reset_fill_boundary(int width, int height);

// Read the brush globals.
ZE_API int ze_get_brush_radius(void);
ZE_API int ze_get_brush_center(void);

ZE_END_FLAT
