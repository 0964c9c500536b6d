// While one of these exists, applications believe that somebody reads the screen and open
// themselves to the accessibility bus. It has to be short: with an open bridge the toolkit swallows
// all keys.
#pragma once

#include <common/Owned.h>

class ScreenReader {
 public:
  explicit ScreenReader(GDBusConnection* sessionBus);
  ~ScreenReader();
  ScreenReader(const ScreenReader&) = delete;
  ScreenReader& operator=(const ScreenReader&) = delete;

  /// The accessibility bus; null when there is none.
  common::OwnedBus connect() const;

 private:
  bool _isOn() const;
  void _set(bool on);

  GDBusConnection* const _bus;
  const int _turn;  // one reader at a time
  bool _wasOn;
};
