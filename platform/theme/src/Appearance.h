/// What is current: the phone's theme and text size, the tables in force, the objects coloured by
/// code. One for the process.
#pragma once

#include <Evas.h>

#include <map>
#include <string>

#include "ColourTable.h"
#include "FontTable.h"

namespace theme {

class Appearance {
 public:
  static Appearance& instance();

  void setChangeable(bool changeable);
  /// Borrowed until the table is forgotten.
  void setColours(const ColourTable* table);
  void setFonts(const FontTable* table);
  void forget(const ColourTable* table);
  void forget(const FontTable* table);

  /// False when the code is unknown. The object keeps following the code until it is deleted.
  bool colourObject(Evas_Object* object, const std::string& code);

 private:
  static void objectDeletedCb(void* data, Evas*, Evas_Object* object, void*);

  void follow();
  void applyColours();
  void applyFonts();

  bool _following = false;
  bool _changeable = false;
  const ColourTable* _colours = nullptr;
  const FontTable* _fonts = nullptr;
  std::map<Evas_Object*, std::string> _objects;
};

}  // namespace theme
