/// Widgets with a name for the screen reader.
#pragma once

#include <Elementary.h>

#include <functional>
#include <string>

namespace companion {

/// A button that owns its handler; `name` is what the screen reader says, the label when empty.
Evas_Object* makeButton(Evas_Object* parent, const char* style, const std::string& label,
                        std::function<void()> onClick, const std::string& name = {});
/// What it reads, and says.
void setLabel(Evas_Object* button, const std::string& label);
Evas_Object* makeCheck(Evas_Object* parent, bool on, const std::string& name);
Evas_Object* makeProgress(Evas_Object* parent, double value);
Evas_Object* makeIcon(Evas_Object* parent, const std::string& path);

void setAccessibleName(Eo* object, const std::string& name);

}  // namespace companion
