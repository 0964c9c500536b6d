#pragma once

#include "ThemeTables.h"

/// The tables in force in this process, borrowed from whoever set them.
struct CurrentTheme {
  const ColorTable* colors = nullptr;
  const FontTable* fonts = nullptr;
  bool changeable = false;

  static CurrentTheme& get();
  /// Light or dark, as the phone is set.
  ThemeStyle style() const;
};
