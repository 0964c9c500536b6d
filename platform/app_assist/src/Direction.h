/// What a window needs in addition when the toolkit has turned it to another reading direction.
#pragma once

#include <Elementary.h>

namespace app_assist {

/// Compressed lists lose their rows: the toolkit forgets how wide they are, and measures again only
/// in a list of another width. And the buttons of a popup that is open stay where they were.
void followDirection(Evas_Object* window);

}  // namespace app_assist
