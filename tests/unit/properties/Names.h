#pragma once

#include <glib.h>
#include <rapidcheck.h>

#include <string>

/// Names as strangers choose them: any bytes, and above all the characters that mean something to
/// markup, formats, folders, lines and writing directions.
inline rc::Gen<std::string> names() {
  const auto meaningful = rc::gen::elementOf(std::vector<std::string>{"<",
                                                                      ">",
                                                                      "&",
                                                                      "\"",
                                                                      "'",
                                                                      "/",
                                                                      "\\",
                                                                      ".",
                                                                      "..",
                                                                      "%s",
                                                                      "%n",
                                                                      ";",
                                                                      "=",
                                                                      " ",
                                                                      "\n",
                                                                      "\t",
                                                                      "\r",
                                                                      "\x7f",
                                                                      "<br>",
                                                                      "</b>",
                                                                      "&lt;",
                                                                      "&#10;",
                                                                      "<item href=x>",
                                                                      "CON",
                                                                      ".jpg",
                                                                      ".desktop"});
  const auto character = rc::gen::map(rc::gen::inRange<gunichar>(1, 0x110000), [](gunichar number) {
    char text[7] = {};
    g_unichar_to_utf8(number, text);
    return std::string(text);
  });
  // Directions, lines, joiners, marks that are drawn over others, places for objects.
  const auto invisible = rc::gen::elementOf(std::vector<std::string>{
      "\u00a0", "\u00ad", "\u0300", "\u200b", "\u200d", "\u200e", "\u200f", "\u2028", "\u2029",
      "\u202a", "\u202c", "\u202e", "\u2066", "\u2069", "\ufe0f", "\ufeff", "\ufffc", "\u0085"});
  const auto byte = rc::gen::map(rc::gen::inRange(1, 256), [](int number) {
    return std::string(1, static_cast<char>(number));
  });
  const auto letter =
      rc::gen::map(rc::gen::inRange('a', 'z'), [](char c) { return std::string(1, c); });
  const auto pieces = rc::gen::container<std::vector<std::string>>(
      rc::gen::oneOf(meaningful, character, invisible, byte, letter));
  return rc::gen::map(pieces, [](const std::vector<std::string>& parts) {
    std::string name;
    for (const auto& part : parts) name += part;
    return name;
  });
}
