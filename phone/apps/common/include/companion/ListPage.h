#pragma once

#include <app_assist.h>

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "companion/ListView.h"
#include "companion/Row.h"

namespace companion {

/// A page with a list of rows, a summary above it and buttons below.
class ListPage : public app_assist::WContentViewController {
 public:
  ListPage();
  ~ListPage() override;

  Evas_Object* onCreateView(Evas_Object* parent, void* viewParam) override;
  Evas_Object* onViewDeleted(Evas_Object* view) override;
  Elm_Object_Item* onPushToNaviframe(Evas_Object* naviframe) override;
  void onPushed(Elm_Object_Item* item) override;

 protected:
  struct Button {
    std::string label;
    std::function<void()> run;
  };

  /// What the row shows now.
  virtual Row row(RowKey key) = 0;
  virtual void onRowTapped(RowKey key);
  /// The buttons along the bottom, left to right; asked for once.
  virtual std::vector<Button> buttons();
  /// A start page has nothing to go back to.
  virtual bool hasBackButton() const { return true; }

  void setRows(const std::vector<RowKey>& keys);
  void updateRow(RowKey key);
  void updateRows();
  /// The summary, empty for none; `progress` from 0 to 1 shows a bar under it.
  void setHeader(const std::string& summary, std::optional<double> progress = {});
  /// Shown instead of the list while it has no rows.
  void setEmptyText(const std::string& emptyText);
  void setButtonEnabled(std::size_t index, bool enabled);

 private:
  void _show(const char* part, bool shown);

  Evas_Object* _layout = nullptr;
  Evas_Object* _progress = nullptr;
  std::vector<Evas_Object*> _buttons;
  std::unique_ptr<ListView> _list;
};

}  // namespace companion
