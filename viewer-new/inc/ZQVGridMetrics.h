#pragma once

#include <Evas.h>

/// Side of a square cell on a screen of this size in its natural position: four cells fit across in
/// portrait, seven in landscape (rotation 90 or 270).
int zqvCellSideFor(int screenWidth, int screenHeight, int rotation);

/// Side of a square cell, in pixels, for the window's rotation.
int zqvGridCellSide(Evas_Object* window);
