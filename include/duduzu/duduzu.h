// The whole public interface of libduduzu.
#pragma once

#include "duduzu/list.h"
#include "duduzu/listset.h"
#include "duduzu/listsort.h"
#include "duduzu/pool.h"
#include "duduzu/session.h"
