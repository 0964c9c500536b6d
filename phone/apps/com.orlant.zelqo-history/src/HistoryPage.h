#pragma once

#include <companion/ContactBook.h>
#include <companion/ListPage.h>
#include <zelqo/Store.h>

#include <vector>

#include "StoreWatch.h"

namespace history {

/// The phone's home: everything that was sent and received, the newest on top.
class HistoryPage : public companion::ListPage {
 public:
  HistoryPage();

  const char* getClassName() override { return "HistoryPage"; }
  void onCreated() override;

  /// Reads the store again.
  void reload();

 protected:
  void showTexts() override;
  companion::Row row(companion::RowKey key) override;
  void onRowTapped(companion::RowKey key) override;
  std::vector<Button> buttons() override;
  bool hasBackButton() const override { return false; }

 private:
  std::string _peopleOf(const zelqo::ShareSummary& share) const;

  zelqo::Store _store;
  std::vector<zelqo::ShareSummary> _shares;  // a row's key is the index here
  companion::ContactBook _contacts;
  StoreWatch _watch;
};

}  // namespace history
