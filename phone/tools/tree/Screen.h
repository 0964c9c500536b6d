// The windows on the screen.
#pragma once

#include <optional>
#include <string>

struct Area {
  int x = 0, y = 0, width = 0, height = 0;
};

struct AppWindow {
  int pid = 0;
  std::string title;
  Area area;
  int rotation = 0;  // of what it shows, in degrees

  /// Where a part of the rotated canvas is on the screen.
  Area onScreen(const Area& canvas) const;
};

/// The application's window that covers the others; nothing when there is none.
std::optional<AppWindow> topWindow();
