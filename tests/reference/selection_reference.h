// Slow, independent models of the selection: queue, engine, lasso, region passes and session.
//
// They follow the behaviour step by step, with numbers for pointers, sets for "seen before" and an
// access that throws for every array, and share no code with the library. A test runs the same
// strokes through both and compares everything that can be seen from outside.
#pragma once

#include "tests/reference/basics_reference.h"
#include "tests/reference/engine_reference.h"
#include "tests/reference/lasso_reference.h"
#include "tests/reference/queue_reference.h"
#include "tests/reference/regions_reference.h"
#include "tests/reference/session_reference.h"
