#pragma once

#include <Eina.h>
#include <stdint.h>

#include <string>
#include <vector>

class ZQViewerThumbnailItem;

/// Who asks for a download; decides which usage records are written.
enum ZQVDownloadCaller : int32_t { ZQV_FROM_SELECT_VIEW = 1, ZQV_FROM_FULL_VIEW = 2 };

/// Hands the checked files of a share over to the file manager's download application. Made for one
/// hand-over and then thrown away.
class ZQVDownloadMgr {
 public:
  /// `items` is borrowed, the texts are copied; null texts count as empty.
  ZQVDownloadMgr(Eina_List* items, bool isWifiOnly, int32_t caller, const char* sender,
                 const char* token);
  virtual ~ZQVDownloadMgr();
  ZQVDownloadMgr(const ZQVDownloadMgr&) = delete;
  ZQVDownloadMgr& operator=(const ZQVDownloadMgr&) = delete;

  /// Marks every checked item as requested and launches the download application with them.
  void _downloadMgrCreate();

 private:
  using Items = std::vector<ZQViewerThumbnailItem*>;

  Items _takeChecked();
  void _record(const Items& taken, const std::vector<const char*>& extensions) const;

  Eina_List* _items;
  bool _isWifiOnly;
  int32_t _caller;
  std::string _sender;
  std::string _token;
  uint64_t _totalSize = 0;
};
