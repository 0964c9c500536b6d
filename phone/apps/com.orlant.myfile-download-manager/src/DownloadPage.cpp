#include "DownloadPage.h"

#include <companion/Launch.h>
#include <companion/Text.h>

#include "DownloadTexts.h"
#include "FileNamer.h"
#include "FolderView.h"

using companion::text;

namespace downloads {
namespace {

constexpr double kRefreshSeconds = 0.25;

struct Total {
  int files = 0;
  std::uint64_t received = 0;
  std::uint64_t size = 0;
};

Total totalOf(const std::vector<const Download*>& list) {
  Total total;
  for (const Download* download : list) {
    if (!download->isPending()) continue;
    total.files++;
    total.received += download->received;
    total.size += std::max(download->size, download->received);
  }
  return total;
}

// A stored file goes by the name under which it is found, which may have got a number.
std::string titleOf(const Download& download) {
  const std::size_t slash = download.path.rfind('/');
  if (download.state != State::Done || slash == std::string::npos) return safeName(download.name);
  return download.path.substr(slash + 1);
}

}  // namespace

DownloadPage::DownloadPage(DownloadManager& manager, GoneHandler onGone)
    : _manager(manager), _onGone(std::move(onGone)) {}

DownloadPage::~DownloadPage() {
  if (_timer) ecore_timer_del(_timer);
  _onGone();
}

void DownloadPage::showTexts() {
  setTitle(text("Downloads"));
  setEmptyText(text("Nothing has been downloaded yet"));
  _refreshHeader();
}

void DownloadPage::onCreated() {
  listChanged();
}

void DownloadPage::onPushed(Elm_Object_Item* item) {
  ListPage::onPushed(item);
  _refreshHeader();
}

void DownloadPage::downloadChanged(std::int64_t id) {
  _changed.insert(id);
  _refreshSoon();
}

void DownloadPage::listChanged() {
  std::vector<companion::RowKey> keys;
  for (const Download* download : _manager.list()) keys.insert(keys.begin(), download->id);
  setRows(keys);
  _refreshHeader();
}

void DownloadPage::_refreshSoon() {
  if (!_timer) _timer = ecore_timer_add(kRefreshSeconds, _refreshCb, this);
}

Eina_Bool DownloadPage::_refreshCb(void* data) {
  auto* page = static_cast<DownloadPage*>(data);
  page->_timer = nullptr;
  page->_refresh();
  return ECORE_CALLBACK_CANCEL;
}

void DownloadPage::_refresh() {
  for (const auto id : _changed) updateRow(id);
  _changed.clear();
  _refreshHeader();
}

void DownloadPage::_refreshHeader() {
  const Total total = totalOf(_manager.list());
  setButtonEnabled(0, _manager.list().size() > static_cast<std::size_t>(total.files));
  if (total.files == 0) {
    _meter.reset();
    setHeader("");
    return;
  }
  _meter.sample(total.received, ecore_time_get());
  std::string summary = companion::filesText(total.files);
  summary += ", " + companion::format("%s of %s", companion::sizeText(total.received).c_str(),
                                      companion::sizeText(total.size).c_str());
  const std::string left = timeLeftText(_meter.secondsFor(total.size - total.received));
  if (!left.empty()) summary += ", " + left;
  const double whole = static_cast<double>(std::max<std::uint64_t>(total.size, 1));
  setHeader(summary, static_cast<double>(total.received) / whole);
}

companion::Row DownloadPage::row(companion::RowKey key) {
  companion::Row row;
  const Download* download = _manager.find(key);
  if (!download) return row;
  row.title = titleOf(*download);
  row.detail = detailOf(*download, _manager.isHeldBack(*download));
  if (download->isPending()) {
    row.progress = download->size == 0 ? 0.0
                                       : static_cast<double>(download->received) /
                                             static_cast<double>(download->size);
  }
  row.actions = _actions(*download);
  return row;
}

std::vector<companion::Row::Action> DownloadPage::_actions(const Download& download) {
  const auto id = download.id;
  const std::string path = download.path;
  if (download.isPending()) return {{text("Cancel"), [this, id] { _manager.cancel(id); }}};
  if (download.state == State::Done) {
    return {{text("Open"), [path] { companion::openFile(path); }},
            {text("Show in folder"), [path] { showInFolder(path); }}};
  }
  if (download.failure == Failure::Address) return {};
  return {{text("Retry"), [this, id] { _manager.retry(id); }}};
}

std::vector<companion::ListPage::Button> DownloadPage::buttons() {
  return {{text("Clear list"), [this] { _manager.forgetEnded(); }}};
}

}  // namespace downloads
