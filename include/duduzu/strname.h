// File-name composition and environment-variable substitution. Results are
// heap strings owned by the caller; inputs are never modified or kept.
//
// A name's directory part runs up to and including its last backslash, or,
// when it has none, its last forward slash; the file part is the rest.
#pragma once

#include "duduzu/export.h"

// Composes a name from the pieces; any piece may be null. ext is given with or
// without its dot. mode:
//   0, 3  dir + stem of name + suffix + ext
//   1     as 0, keeping the old extension of name when ext is null
//   2     directory part of name + dir + stem + suffix + (ext or old extension)
//   4     dir + directory part of name + suffix + ext
// The old extension is the file part from its last dot. With a null name every
// mode gives dir + suffix + ext. Null for any other mode or when no piece at
// all is present. dir is put in as given (with its trailing separator).
DUDUZU_API char* StrComposeName(char* name, const char* dir, const char* suffix, const char* ext,
                                int mode);
// The file part of path up to its first dot ("dir/a.tar.gz" gives "a"); null
// for a null path.
DUDUZU_API char* StrComposeBaseName(const char* path);
// s with every $NAME (NAME running to the next slash, backslash or the end)
// whose variable is set replaced by its value; unset ones stay as written.
// Null when s is null or nothing was replaced.
DUDUZU_API char* StrReplaceEnvVariable(char* s);
