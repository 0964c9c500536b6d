// What the viewer shows: its texts, as the probe inside it tells them.
#pragma once

#include <common/Owned.h>

#include <optional>
#include <string>
#include <vector>

struct Area {
  int x = 0, y = 0, width = 0, height = 0;

  int right() const { return x + width; }
  int bottom() const { return y + height; }
};

Area overlap(const Area& a, const Area& b);

struct Text {
  std::string words;
  bool isCutOff = false;  ///< it wants more room than it has
  bool mayEndInDots = false;
  bool scrolls = false;  ///< it lies in something that moves below a finger
  bool isInPopup = false;
  Area lines;        ///< what is drawn of it
  Area seen;         ///< what is left of that by what lies around it
  double scale = 1;  ///< smaller than the screen's when it was made to fit
};

struct Look {
  std::string language;
  Area screen;
  int rotation = 0;
  std::vector<Text> texts;
};

/// Waits until the page is in that language and does not change any more; nothing when that never
/// happens.
std::optional<Look> lookIn(GDBusConnection* bus, const std::string& language);
