/// The pictures of a download's state: null-terminated lists for ZQViewerCommon::createGif.
#pragma once

extern const char* zqvDownloadedSmallFrames[];
extern const char* zqvDownloadedLargeFrames[];
extern const char* zqvDownloadingSmallFrames[];
extern const char* zqvDownloadingLargeFrames[];
