// The whole public interface of libduduzu.
#pragma once

#include "duduzu/intutil.h"
#include "duduzu/list.h"
#include "duduzu/param.h"
#include "duduzu/pool.h"
#include "duduzu/session.h"
#include "duduzu/str.h"
#include "duduzu/strlist.h"
#include "duduzu/strname.h"
