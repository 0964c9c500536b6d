#include "Widget.h"

#include <algorithm>
#include <cstring>
#include <iterator>

namespace {

// In the order of their bits.
constexpr const char* kStates[] = {"invalid",         "active",
                                   "armed",           "busy",
                                   "checked",         "collapsed",
                                   "defunct",         "editable",
                                   "enabled",         "expandable",
                                   "expanded",        "focusable",
                                   "focused",         "has-tooltip",
                                   "horizontal",      "iconified",
                                   "modal",           "multi-line",
                                   "multiselectable", "opaque",
                                   "pressed",         "resizable",
                                   "selectable",      "selected",
                                   "sensitive",       "showing",
                                   "single-line",     "stale",
                                   "transient",       "vertical",
                                   "visible",         "manages-descendants",
                                   "indeterminate",   "required",
                                   "truncated",       "animated",
                                   "invalid-entry",   "supports-autocompletion",
                                   "selectable-text", "is-default",
                                   "visited"};

// Either the same as "enabled", or true of everything that is listed.
constexpr const char* kSilent[] = {"enabled", "sensitive", "visible", "opaque"};

std::string quoted(const std::string& text) {
  std::string result = "\"";
  for (const char c : text) {
    if (c == '"' || c == '\\') result += '\\';
    if (c == '\n') {
      result += "\\n";
    } else if (c == '\t') {
      result += "\\t";
    } else {
      result += c;
    }
  }
  return result + '"';
}

std::string statesOf(const Widget& widget) {
  std::string result = widget.is("enabled") ? "enabled" : "disabled";
  for (size_t bit = 0; bit < std::size(kStates); bit++) {
    const char* name = kStates[bit];
    const bool silent = std::any_of(std::begin(kSilent), std::end(kSilent),
                                    [&](const char* one) { return strcmp(one, name) == 0; });
    if (!silent && (widget.states >> bit & 1)) result.append(",").append(name);
  }
  return result;
}

std::string line(int depth, const std::string& role, const std::string& name,
                 const std::string& states, const Area& area) {
  return std::string(2 * depth, ' ') + role + ' ' + quoted(name) + " [" + states + "] " +
         std::to_string(area.x) + ',' + std::to_string(area.y) + ' ' + std::to_string(area.width) +
         'x' + std::to_string(area.height) + '\n';
}

void describeInto(std::string& text, const Widget& widget, const AppWindow& window, int depth) {
  if (!widget.is("visible")) return;
  if (widget.hasArea) {
    text += line(depth, widget.role, widget.name, statesOf(widget), window.onScreen(widget.area));
  }
  for (const auto& child : widget.children) describeInto(text, *child, window, depth + 1);
}

}  // namespace

bool Widget::is(const char* state) const {
  const auto found = std::find_if(std::begin(kStates), std::end(kStates),
                                  [&](const char* name) { return strcmp(name, state) == 0; });
  return found != std::end(kStates) && (states >> (found - std::begin(kStates)) & 1);
}

std::string describe(const Widget& root, const AppWindow& window) {
  std::string text;
  for (const auto& child : root.children) describeInto(text, *child, window, 0);
  return text;
}

std::string describe(const AppWindow& window) {
  return line(0, "window", window.title, "enabled,showing", window.area);
}
