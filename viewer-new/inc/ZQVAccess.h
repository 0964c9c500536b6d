/// What a screen reader says of the things on a page.
#pragma once

#include <Elementary.h>

#include <string>

class ZQViewerThumbnailItem;

/// Names a grid item or row; also a button that has no text of its own.
void zqvSetAccessibleName(Eo* object, const std::string& name);

/// A file in words: name, size, kind and state.
std::string zqvCellName(const ZQViewerThumbnailItem& item);
