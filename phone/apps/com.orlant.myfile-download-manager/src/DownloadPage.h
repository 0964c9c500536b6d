#pragma once

#include <Ecore.h>
#include <companion/ListPage.h>

#include <set>

#include "DownloadManager.h"
#include "ProgressMeter.h"

namespace downloads {

/// The list of downloads, the newest on top.
class DownloadPage : public companion::ListPage {
 public:
  /// Says that the page is gone.
  using GoneHandler = std::function<void()>;

  DownloadPage(DownloadManager& manager, GoneHandler onGone);
  ~DownloadPage() override;

  const char* getClassName() override { return "DownloadPage"; }
  void onCreated() override;
  void onPushed(Elm_Object_Item* item) override;

  /// Shown a little later, together with whatever else changes until then.
  void downloadChanged(std::int64_t id);
  void listChanged();

 protected:
  void showTexts() override;
  companion::Row row(companion::RowKey key) override;
  std::vector<Button> buttons() override;

 private:
  static Eina_Bool _refreshCb(void* data);
  void _refreshSoon();
  void _refresh();
  void _refreshHeader();
  std::vector<companion::Row::Action> _actions(const Download& download);

  DownloadManager& _manager;
  GoneHandler _onGone;
  ProgressMeter _meter;
  std::set<std::int64_t> _changed;
  Ecore_Timer* _timer = nullptr;
};

}  // namespace downloads
