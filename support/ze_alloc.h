// Six thin wrappers over the C library's memory functions. They check nothing and log nothing; the
// work buffers of the region passes come from ze_calloc.
#pragma once

#include <stddef.h>

#include "support/ze_api.h"

ZE_BEGIN_FLAT

// calloc(count, size)
ZE_API void* ze_calloc(size_t count, size_t size);

// malloc(count * size). Deliberate: two arguments, multiplied without an overflow check.
ZE_API void* ze_malloc(size_t count, size_t size);

// memset, free, memcpy and realloc.
ZE_API void* ze_memset(void* target, int value, size_t size);
ZE_API void ze_free(void* block);
ZE_API void* ze_memcpy(void* target, const void* source, size_t size);
ZE_API void* ze_realloc(void* block, size_t size);

ZE_END_FLAT
