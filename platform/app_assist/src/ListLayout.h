/// What lists need after the toolkit has turned a window to another reading direction.
#pragma once

#include <Elementary.h>

namespace app_assist {

/// Brings the rows of compressed lists back: the toolkit forgets how wide they are when it applies
/// its theme again, and asks only for a list of another width.
void layOutListsAgain(Evas_Object* window);

}  // namespace app_assist
