// The whole public interface of libduduzu.
#pragma once

#include "duduzu/file.h"
#include "duduzu/intutil.h"
#include "duduzu/list.h"
#include "duduzu/pool.h"
#include "duduzu/session.h"
#include "duduzu/str.h"
#include "duduzu/system.h"
