// One widget of the accessible tree, and how it is written down.
#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <vector>

#include "Screen.h"

struct Widget {
  std::string bus, path;  // where it is on the accessibility bus
  std::string role, name;
  uint64_t states = 0;
  bool hasArea = false;
  Area area;  // in coordinates of the window's canvas
  std::vector<std::unique_ptr<Widget>> children;

  bool is(const char* state) const;
};

/// One line per widget that can be seen, children indented below their parents. Items of a list
/// are there also while they are scrolled out of sight, then without "showing".
std::string describe(const Widget& root, const AppWindow& window);

/// The line of a window whose application tells nothing.
std::string describe(const AppWindow& window);
