#pragma once

#include <companion/CompanionApp.h>

#include <map>
#include <memory>
#include <string>

#include "DownloadManager.h"
#include "DownloadSignals.h"
#include "NetworkWatch.h"

namespace downloads {

class DownloadPage;

/// Downloads in the background; its window is there when the user asks for it.
class DownloadApp : public companion::CompanionApp, private DownloadManager::Observer {
 public:
  using CompanionApp::CompanionApp;
  ~DownloadApp() override;

  bool onCreate() override;
  void onTerminate() override;
  void onAppControl(app_control_h request) override;

 protected:
  bool onLeave() override;

 private:
  struct Batch {
    int done = 0;
    int failed = 0;
    std::string lastName;
  };

  // DownloadManager::Observer
  void onStarted(const Download& download) override;
  void onDone(const Download& download) override;
  void onFailed(const Download& download) override;
  void onCancelled(const Download& download) override;
  void onChanged(const Download& download) override;
  void onListChanged() override;

  void _showList();
  void _notifyWhenComplete(const std::string& token);

  DownloadSignals _signals;
  std::unique_ptr<DownloadManager> _manager;
  std::unique_ptr<NetworkWatch> _network;
  std::map<std::string, Batch> _batches;  // by share, what ended since its last notification
  DownloadPage* _page = nullptr;          // the naviframe's
};

}  // namespace downloads
