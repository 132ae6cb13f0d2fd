// The definition of objectsel.h's functions that scan the whole mask: one pixel after another.
// Tests and benchmarks compare with it; the library does not hold it.
//
// Both set g_object_boundary, like the exported functions of these names.
#pragma once

namespace plain {

void ze_inverse_mask(unsigned char* mask, int width, int height);

void ze_update_objectROI(unsigned char* mask, int width, int height);

}  // namespace plain
