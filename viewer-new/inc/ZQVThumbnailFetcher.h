#pragma once

#include <Eina.h>
#include <zelqo.h>

#include <string>
#include <vector>

#include "ZQVOwned.h"
#include "ZQVTimer.h"

class ZQViewerThumbnailItem;

/// Gives the files of a received share their pictures: from an earlier visit, or from the service.
class ZQVThumbnailFetcher {
 public:
  ZQVThumbnailFetcher() = default;
  ZQVThumbnailFetcher(const ZQVThumbnailFetcher&) = delete;
  ZQVThumbnailFetcher& operator=(const ZQVThumbnailFetcher&) = delete;

  /// The share to work on. `items` is borrowed until the next call or forgetShare(); each item's
  /// `index` is the file's number at the service.
  void setShare(Eina_List* items, const char* contentsToken);
  /// Before the items go: no refresh is pending afterwards. Pictures that are still on their way
  /// find nobody.
  void forgetShare();

  void _getContentInfoNReqNormalThumbnail(zelqo_share_h handle);
  void _reqMidThumbnail(zelqo_share_h handle);
  void stopWatchdogs();

  static int _SAPIDownloadCb(unsigned int requestId, int error, const char* downloadPath,
                             const char* thumbUrl, unsigned int remaining, void* app);
  /// The path that the file manager recorded for a download address; null for none.
  static ZQVOwnedText _getItemFromJson(const char* url);
  static bool _checkAndCreateFolder(const char* path);

 private:
  using Urls = std::vector<const char*>;

  static void _readContentInfo(zelqo_share_h handle, int serviceIndex, ZQViewerThumbnailItem* item);
  static void _reuseThumbnail(ZQViewerThumbnailItem* item, Urls* missing);
  static void _reuseMidThumbnail(ZQViewerThumbnailItem* item, Urls* missing);
  void _request(Urls& urls, const char* folder);
  bool _isMarkedComplete() const;
  void _arrived(const char* path, const char* url);
  void _normalArrived(ZQViewerThumbnailItem* item, const char* path);
  ZQViewerThumbnailItem* _find(const char* url, bool mid) const;
  static bool _clearNormalThumbnailTimerCb(ZQVThumbnailFetcher* app);
  static bool _clearMidThumbnailTimerCb(ZQVThumbnailFetcher* app);

  Eina_List* _items = nullptr;
  std::vector<int> _serviceIndices;
  std::string _contentsToken;
  ZQVTimer _normalThumbTimer;
  ZQVTimer _midThumbTimer;
  ZQVTimer _gridRefresh;
  ZQVTimer _fullViewRefresh;
};
