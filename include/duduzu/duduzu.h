// The whole public interface of libduduzu.
#pragma once

#include "duduzu/list.h"
#include "duduzu/pool.h"
#include "duduzu/session.h"
#include "duduzu/str.h"
#include "duduzu/strlist.h"
#include "duduzu/strname.h"
