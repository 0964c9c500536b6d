/// What a layout notes of its clipper, 32 bytes, the toolkit forgets to free when the layout goes.
/// Two layouts in a cell make that the only memory that page after page does not give back.
#pragma once

#include <Elementary.h>

namespace app_assist {

/// For a view that is about to go: the notes of all layouts in it go with them.
void ownClipRecords(Evas_Object* view);

}  // namespace app_assist
