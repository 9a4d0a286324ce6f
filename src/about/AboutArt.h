#pragma once

#include <QImage>

// The About window's two pictures, drawn by the program itself so that it ships no
// photographs: a dark starfield tile for the background, which repeats without seams,
// and a joystick for the picture box.
QImage aboutBackgroundTile();
QImage aboutPicture();
