#include "PickerPage.h"

#include <companion/CompanionApp.h>
#include <companion/Text.h>
#include <zelqo/PhoneSettings.h>

#include <numeric>

using companion::format;
using companion::text;

namespace picker {

PickerPage::PickerPage(const PickerRequest& request, companion::PendingReply reply)
    : _request(request),
      _reply(std::move(reply)),
      _uploader(_store),
      _contacts([this] { _reload(); }) {}

void PickerPage::showTexts() {
  setEmptyText(text("There is nobody in the address book"));
  _showSelection();
}

void PickerPage::onCreated() {
  _reload();
}

void PickerPage::onPushed(Elm_Object_Item* item) {
  ListPage::onPushed(item);
  _showSelection();
}

void PickerPage::_reload() {
  _entries = _contacts.all();
  std::vector<companion::RowKey> keys(_entries.size());
  std::iota(keys.begin(), keys.end(), 0);
  setRows(keys);
}

companion::Row PickerPage::row(companion::RowKey key) {
  const auto& entry = _entries.at(static_cast<std::size_t>(key));
  companion::Row row;
  row.title = entry.name;
  row.detail = entry.number;
  row.icon = entry.picture.empty() ? companion::imageFile("person.png") : entry.picture;
  row.checked = _selected.count(entry.number) > 0;
  return row;
}

void PickerPage::onRowTapped(companion::RowKey key) {
  if (_isSending) return;
  const std::string& number = _entries.at(static_cast<std::size_t>(key)).number;
  if (_selected.erase(number) == 0) {
    if (_selected.size() >= _request.maxContacts) {
      companion::showMessage(
          format("No more than %d at once", static_cast<int>(_request.maxContacts)));
      return;
    }
    _selected.insert(number);
  }
  updateRow(key);
  _showSelection();
}

void PickerPage::_showSelection() {
  const auto count = static_cast<int>(_selected.size());
  setTitle(count == 0 ? text("Select recipients") : format("%d selected", count).c_str());
  setButtonEnabled(0, count > 0 && !_isSending);
}

std::vector<companion::ListPage::Button> PickerPage::buttons() {
  return {{text("Send"), [this] { _send(); }}};
}

void PickerPage::_send() {
  const auto share = _store.sent(_request.shareId);
  if (!share) {
    companion::showMessage(text("This share is no longer on the phone"));
    return;
  }
  zelqo::Uploader::Request upload;
  upload.from = share->sender.empty() ? zelqo::ownNumber() : share->sender;
  upload.to.assign(_selected.begin(), _selected.end());
  upload.paths = share->paths;
  upload.single = _request.isSingle;
  _isSending = _uploader.start(
      std::move(upload),
      [this](std::int64_t sent, std::int64_t total) {
        setHeader(text("Sending…"), total > 0 ? static_cast<double>(sent) / total : 0.0);
      },
      [this](const zelqo::Uploader::Result& result) { _sent(result); });
  if (_isSending) setHeader(text("Sending…"), 0.0);
  _showSelection();
}

void PickerPage::_sent(const zelqo::Uploader::Result& result) {
  _isSending = false;
  if (result.error != 0) {
    g_warning("picker: not sent: %s", result.reason.c_str());
    setHeader(text("Sending did not work. Try again."));
    _showSelection();
    return;
  }
  companion::showMessage(text("Sent"));
  _reply.send(APP_CONTROL_RESULT_SUCCEEDED);
  getNaviframe()->pop();
}

}  // namespace picker
