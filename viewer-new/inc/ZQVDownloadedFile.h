/// Where a downloaded file lies, and whether it may be given to another program.
#pragma once

#include <string>

class ZQViewerThumbnailItem;

/// The path under which a received file is expected: what the file manager recorded for its address
/// when that lies in the download folder, else the download folder and the file's name. Empty when
/// the name cannot be a file's name.
std::string zqvDownloadedPath(const ZQViewerThumbnailItem& item);

/// Is there a file of this name in the download folder that came from the item's address?
bool zqvIsDownloadedByName(const ZQViewerThumbnailItem& item);

/// Has the file manager downloaded this file, and is it still there?
bool zqvIsDownloaded(const ZQViewerThumbnailItem& item);

/// May a file that came from somebody else be opened? Only a readable regular file that nothing on
/// this phone would run: no link, no execute bit, no program, script or desktop entry, by its
/// content. A refusal is logged.
bool zqvMayBeOpened(const char* path);
