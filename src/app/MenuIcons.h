#pragma once

#include <QIcon>

// The menu icons by their index in the window's image list: 0 configuration,
// 1 background, 3 exit, 4 text colour, 5 information, 7 and 8 home pages, 9 load, 10 save.
QIcon menuIcon(int index);
