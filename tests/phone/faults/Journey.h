/// The main ways through the viewer, as fingers go them: receive, page, download, open, reshare,
/// recall, with which the viewer ends. Touches places, whatever is there by then.
#pragma once

#include <functional>
#include <string>

#include "LoopWatch.h"
#include "Phone.h"

class Journey {
 public:
  /// Shares what is needed. As long as this object lives, a text that is opened covers nothing.
  Journey();
  ~Journey();
  Journey(const Journey&) = delete;
  Journey& operator=(const Journey&) = delete;

  /// All ways, one after the other, up to that which is enough. False when the viewer once neither
  /// answered nor ended.
  bool go(LoopWatch& watch, const std::function<bool()>& isEnough = {}) const;

  const phone::Share& received() const { return _received; }
  const phone::Share& sent() const { return _sent; }

 private:
  const phone::Share _received, _sent;
  const std::string _editor;
};

/// Where things are on the viewer's pages.
namespace place {
constexpr const char* kFirstCell = "90,366";
constexpr const char* kBottomButton = "360,1212";  // Download, Open
constexpr const char* kDownload = kBottomButton;
constexpr const char* kOpen = kBottomButton;
constexpr const char* kSelectAll = "360,215";
constexpr const char* kDone = "636,103";
constexpr const char* kRecall = "194,1212";
constexpr const char* kReshare = "526,1212";
constexpr const char* kOk = "552,1212";
}  // namespace place
