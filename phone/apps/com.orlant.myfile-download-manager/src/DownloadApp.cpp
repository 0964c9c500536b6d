#include "DownloadApp.h"

#include <app_common.h>
#include <appfw/PreferenceStore.h>
#include <base/PhonePaths.h>
#include <companion/Launch.h>
#include <companion/Text.h>
#include <notification/post.h>
#include <zelqo/Store.h>

#include <cstdlib>

#include "DownloadPage.h"
#include "DownloadRequest.h"
#include "FileNamer.h"

using companion::format;

namespace downloads {
namespace {

constexpr const char* kViewer = "com.orlant.zelqo";
constexpr const char* kFileManager = "com.orlant.myfile-lite";

DownloadManager::Folders folders() {
  const common::OwnedPlainText data(app_get_data_path());
  return {base::phoneRoot() + "/media/Downloads", std::string(data.get()) + "queue.db",
          base::applicationFolder(kFileManager) + "shared/data/zelqo/zelqo.json"};
}

std::string doneText(int count, const std::string& lastName) {
  if (count == 1) return format("%s downloaded", safeName(lastName).c_str());
  return format("%d files downloaded", count);
}

std::string failedText(int count, const std::string& lastName) {
  if (count == 1) return format("%s could not be downloaded", safeName(lastName).c_str());
  return format("%d files could not be downloaded", count);
}

void openShare(const std::string& token) {
  const auto share = zelqo::Store().received(token);
  companion::openReceivedShare(token, share && share->single);
}

}  // namespace

DownloadApp::~DownloadApp() = default;

bool DownloadApp::onCreate() {
  _manager.reset(new DownloadManager(folders(), *this));
  _network =
      std::make_unique<NetworkWatch>([this](Network network) { _manager->setNetwork(network); });
  return true;
}

void DownloadApp::onTerminate() {
  _network.reset();
  _manager.reset();
}

void DownloadApp::onAppControl(app_control_h request) {
  auto wanted = readRequest(request);
  if (wanted.empty()) {
    _showList();
  } else {
    _manager->add(std::move(wanted));
  }
  companion::reply(request, APP_CONTROL_RESULT_SUCCEEDED);
}

void DownloadApp::_showList() {
  if (!_page) {
    _page = new DownloadPage(*_manager, [this] { _page = nullptr; });
    pages()->push(_page);
  }
  raise();
}

// What still runs goes on out of sight.
bool DownloadApp::onLeave() {
  lower();
  return true;
}

void DownloadApp::onStarted(const Download& download) {
  _signals.downloading(download.url);
}

void DownloadApp::onDone(const Download& download) {
  // The viewer takes a file of the right name for the shared one only with this note of ours.
  appfw::PreferenceStore(kViewer).setText(download.url, download.url);
  _signals.downloaded(download.url);
  Batch& batch = _batches[download.token];
  batch.done++;
  batch.lastName = download.name;
  _notifyWhenComplete(download.token);
}

void DownloadApp::onFailed(const Download& download) {
  Batch& batch = _batches[download.token];
  batch.failed++;
  batch.lastName = download.name;
  _notifyWhenComplete(download.token);
}

void DownloadApp::onCancelled(const Download& download) {
  _notifyWhenComplete(download.token);
}

void DownloadApp::_notifyWhenComplete(const std::string& token) {
  for (const Download* download : _manager->list()) {
    if (download->token == token && download->isPending()) return;
  }
  const Batch batch = _batches[token];
  _batches.erase(token);
  if (batch.failed > 0) {
    notification::post(failedText(batch.failed, batch.lastName), [this] { _showList(); });
  } else if (batch.done > 0 && !token.empty()) {
    notification::post(doneText(batch.done, batch.lastName), [token] { openShare(token); });
  } else if (batch.done > 0) {
    notification::post(doneText(batch.done, batch.lastName), [this] { _showList(); });
  }
}

void DownloadApp::onChanged(const Download& download) {
  if (_page) _page->downloadChanged(download.id);
}

void DownloadApp::onListChanged() {
  if (_page) _page->listChanged();
}

}  // namespace downloads
