#pragma once

#include <Evas.h>

/// Where an object was pressed last, in canvas coordinates; the object's data "point_down".
struct ZQVPressPoint {
  int x;
  int y;

  /// Null for an object that was not made clickable.
  static ZQVPressPoint* of(Evas_Object* object) {
    return static_cast<ZQVPressPoint*>(evas_object_data_get(object, "point_down"));
  }
  /// Has a finger that is now at this point moved more than `distance` pixels on some axis?
  bool isFurtherThan(int distance, const Evas_Coord_Point& now) const {
    return now.x - x > distance || x - now.x > distance || now.y - y > distance ||
           y - now.y > distance;
  }
};
