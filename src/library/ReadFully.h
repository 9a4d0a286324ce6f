#pragma once

#include <QtGlobal>

// Reads up to `size` bytes from a file descriptor, retrying short and interrupted reads;
// the count read (less only at the end of the file), or -1 on an error.
qint64 readFully(int fd, unsigned char* buffer, qint64 size);
