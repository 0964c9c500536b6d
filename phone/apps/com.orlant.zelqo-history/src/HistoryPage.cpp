#include "HistoryPage.h"

#include <companion/CompanionApp.h>
#include <companion/Launch.h>
#include <companion/Text.h>

#include <algorithm>
#include <numeric>

#include "HistoryTexts.h"

using companion::text;

namespace history {
namespace {

constexpr const char* kDownloads = "com.orlant.myfile-download-manager";

std::int64_t nowMs() {
  return g_get_real_time() / 1000;
}

}  // namespace

HistoryPage::HistoryPage() : _contacts([this] { updateRows(); }), _watch([this] { reload(); }) {}

void HistoryPage::showTexts() {
  setTitle(text("Sharing history"));
  setEmptyText(text("Nothing has been shared yet"));
}

void HistoryPage::onCreated() {
  reload();
}

void HistoryPage::reload() {
  _shares = _store.list();
  _shares.erase(std::remove_if(_shares.begin(), _shares.end(),
                               [](const auto& share) { return !isShown(share); }),
                _shares.end());
  std::vector<companion::RowKey> keys(_shares.size());
  std::iota(keys.begin(), keys.end(), 0);
  setRows(keys);
}

std::string HistoryPage::_peopleOf(const zelqo::ShareSummary& share) const {
  std::string people;
  for (const auto& number : share.numbers) {
    people += (people.empty() ? "" : ", ") + _contacts.nameOf(number);
  }
  return people;
}

companion::Row HistoryPage::row(companion::RowKey key) {
  const auto& share = _shares.at(static_cast<std::size_t>(key));
  companion::Row row;
  row.title = _peopleOf(share);
  row.detail = detailOf(share, nowMs());
  const char* icon = share.received ? "received.png" : "sent.png";
  row.icon = companion::imageFile(isGone(share, nowMs()) ? "gone.png" : icon);
  return row;
}

void HistoryPage::onRowTapped(companion::RowKey key) {
  const auto& share = _shares.at(static_cast<std::size_t>(key));
  if (share.received) {
    companion::openReceivedShare(share.token, share.single);
  } else {
    companion::openSentShare(static_cast<int>(share.requestId), share.single);
  }
}

std::vector<companion::ListPage::Button> HistoryPage::buttons() {
  return {{text("Downloads"), [] { companion::openApplication(kDownloads); }}};
}

}  // namespace history
