// The whole public interface of libduduzu.
#pragma once

#include "duduzu/file.h"
#include "duduzu/intutil.h"
#include "duduzu/list.h"
#include "duduzu/listset.h"
#include "duduzu/listsort.h"
#include "duduzu/mint.h"
#include "duduzu/param.h"
#include "duduzu/pool.h"
#include "duduzu/qelmsg.h"
#include "duduzu/redirect.h"
#include "duduzu/session.h"
#include "duduzu/str.h"
#include "duduzu/strlist.h"
#include "duduzu/strname.h"
#include "duduzu/system.h"
#include "duduzu/userobj.h"
