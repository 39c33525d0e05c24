// The whole public interface of libduduzu.
#pragma once

#include "duduzu/list.h"
#include "duduzu/mint.h"
#include "duduzu/pool.h"
#include "duduzu/session.h"
