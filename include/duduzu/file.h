// File services: tracked opening and closing of C streams, existence tests,
// fall-back opening, copying, file-name splitting, temporary names and the
// end-of-session clean-up.
//
// Strings returned here are new heap strings owned by the caller (StrFree or
// vzl_free). Functions taking a name return their empty result (null or 0) at
// once for a null name.
#pragma once

#include <cstdio>

#include "duduzu/export.h"

// Tracked opens: the handle joins the open-file list that FileRemoveAllFilesInTmp
// closes. FOPEN reports a failed open and leaves through ExitToSession(5);
// KERB_FOPEN returns null instead.
DUDUZU_API FILE* FOPEN(const char* name, const char* mode);
DUDUZU_API FILE* KERB_FOPEN(const char* name, const char* mode);
// Closes any stream, tracked or not, and takes it off the open-file list.
// Returns fclose's result; a failed close is reported with the stream's
// status flags before and after.
DUDUZU_API int FCLOSE(FILE* stream);

// Untracked opens with mode "r" and "w".
DUDUZU_API FILE* FileExistThenOpenRead(const char* name);
DUDUZU_API FILE* FileOpenWrite(const char* name);
// Open name, else altDir followed directly by name (altDir ends with its
// separator); when both fail and report is non-zero, "File not found" is
// reported with name as given.
DUDUZU_API FILE* FileOpenReadAlternate(const char* name, const char* altDir, int report);
DUDUZU_API FILE* FileOpenWriteAlternate(const char* name, const char* altDir, int report);

// 1 when name opens with mode "r" or "w" (either case), else 0. Mode "w"
// creates or truncates the file.
DUDUZU_API int FileExist(const char* name, const char* mode);

// Copies from each stream's current position to the end of from; closes nothing.
DUDUZU_API void FileCopyFileToFile(FILE* from, FILE* to);
// 1 copied (the source is closed, the destination is not), 0 source missing.
DUDUZU_API int FileCopyFileNameToFile(char* fromName, FILE* to);
// 1 copied (toName created or truncated), 0 failed.
DUDUZU_API int FileCopyFileNameToFileName(char* fromName, char* toName);
// Deletes name when it exists and is readable; reports nothing.
DUDUZU_API void FileRemoveFile(const char* name);

// Name splitting. FileRemoveExtension cuts at the first dot of the base name
// (a.b.c gives a); FileGetFileExtension gives the text after the last dot of
// the last component (a.b.c gives c), null when there is none.
DUDUZU_API char* FileRemoveExtension(const char* name);
DUDUZU_API char* FileGetDirName(char* name);
DUDUZU_API char* FileGetFileExtension(char* name);

// Temporary names. FileRandomNameNoExtension gives "p", four base-36 digits of
// the process number and three of a name counter (names repeat after 46656).
// The Tmp names are KERBTmpDir (which ends with its separator) followed by
// such a name and ".extension" (none for a null extension), and are
// registered for clean-up. No file is created. Null, with nothing
// registered, when memory runs out.
DUDUZU_API char* FileRandomNameNoExtension();
DUDUZU_API char* FileCreateNameInTmpWithExtension(const char* extension);
DUDUZU_API char* FileCreateRandomName();
// Registers a copy of name for removal by FileRemoveAllFilesInTmp.
DUDUZU_API void FileAddFileNameForCleanOnExit(char* name);
// End-of-session clean-up: closes every tracked handle, removes every
// registered file that exists, then KERBTmpDir's "kerb<process number>.ren".
DUDUZU_API void FileRemoveAllFilesInTmp();
