// The open-file list of the tracked opens, kept by the file unit.
#pragma once

// Closes every tracked handle with FCLOSE, in list order, and deletes the
// list; the next tracked open starts a new one.
void FileCloseAllTracked();
