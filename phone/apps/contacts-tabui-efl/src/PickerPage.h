#pragma once

#include <companion/ContactBook.h>
#include <companion/Launch.h>
#include <companion/ListPage.h>
#include <zelqo/Store.h>
#include <zelqo/Uploader.h>

#include <set>
#include <string>
#include <vector>

#include "PickerRequest.h"

namespace picker {

/// The address book, to choose who gets a share.
class PickerPage : public companion::ListPage {
 public:
  PickerPage(const PickerRequest& request, companion::PendingReply reply);

  const char* getClassName() override { return "PickerPage"; }
  void onCreated() override;
  void onPushed(Elm_Object_Item* item) override;

 protected:
  void showTexts() override;
  companion::Row row(companion::RowKey key) override;
  void onRowTapped(companion::RowKey key) override;
  std::vector<Button> buttons() override;

 private:
  void _reload();
  void _showSelection();
  void _send();
  void _sent(const zelqo::Uploader::Result& result);

  const PickerRequest _request;
  companion::PendingReply _reply;
  zelqo::Store _store;
  zelqo::Uploader _uploader;
  companion::ContactBook _contacts;
  std::vector<companion::ContactBook::Entry> _entries;  // a row's key is the index here
  std::set<std::string> _selected;                      // numbers
  bool _isSending = false;
};

}  // namespace picker
