#pragma once

#include <Evas.h>
#include <glib.h>

/// Where an object was pressed last, in canvas coordinates, and whether the finger has moved since:
/// the object's data "point_down" and "bMoving".
struct ZQVPressPoint {
  /// A finger that moves further than this, in pixels, does not tap.
  static constexpr int kTapDistance = 30;

  int x;
  int y;

  /// Null for an object that was not made clickable.
  static ZQVPressPoint* of(Evas_Object* object) {
    return static_cast<ZQVPressPoint*>(evas_object_data_get(object, "point_down"));
  }
  /// `press` is borrowed until forget.
  static void set(Evas_Object* object, const ZQVPressPoint* press) {
    evas_object_data_set(object, "point_down", press);
  }
  static void forget(Evas_Object* object) {
    evas_object_data_del(object, "point_down");
    evas_object_data_del(object, "bMoving");
  }

  static bool isMoving(Evas_Object* object) {
    return evas_object_data_get(object, "bMoving") != nullptr;
  }
  static void setMoving(Evas_Object* object, bool moving) {
    evas_object_data_set(object, "bMoving", GINT_TO_POINTER(moving));
  }

  /// Has a finger that is now at this point moved more than `distance` pixels on some axis?
  bool isFurtherThan(int distance, const Evas_Coord_Point& now) const {
    return now.x - x > distance || x - now.x > distance || now.y - y > distance ||
           y - now.y > distance;
  }
};
