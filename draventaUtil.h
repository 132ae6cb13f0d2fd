// Everything that libdraventaUtil.so offers to native code.
//
// The flat functions are for C99 and C++17; the classes behind them, ER_selection and D_Queue, for
// C++17 alone. Start with selection/objectsel.h: a session is ze_set_brush_size, ze_init_objectsel,
// one ze_modify_objectsel for each point of a stroke, ze_destroy_objectsel.
#pragma once

#include "render/compositing.h"
#include "render/mask_transfer.h"
#include "selection/objectsel.h"
#include "selection/region_shaping.h"
#include "selection/ze_rect.h"
#include "support/fixed_point.h"
#include "support/ze_alloc.h"

#ifdef __cplusplus
#include "selection/D_Queue.h"
#include "selection/ER_selection.h"
#endif
