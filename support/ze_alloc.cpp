#include "support/ze_alloc.h"

#include <cstdlib>
#include <cstring>

void* ze_calloc(size_t count, size_t size) { return std::calloc(count, size); }

void* ze_malloc(size_t count, size_t size) { return std::malloc(count * size); }

void* ze_memset(void* target, int value, size_t size) { return std::memset(target, value, size); }

void ze_free(void* block) { std::free(block); }

void* ze_memcpy(void* target, const void* source, size_t size) {
    return std::memcpy(target, source, size);
}

void* ze_realloc(void* block, size_t size) { return std::realloc(block, size); }
