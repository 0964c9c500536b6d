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

  /// Sets the page's own texts: title, summary, what stands instead of an empty list. Asked for
  /// when the page is made and whenever the language changes.
  virtual void showTexts() = 0;
  /// What the row shows now.
  virtual Row row(RowKey key) = 0;
  virtual void onRowTapped(RowKey key);
  /// The buttons along the bottom, left to right; always the same but for the language.
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
  static void _languageChangedCb(void* data, Evas_Object* layout, void* info);
  void _show(const char* part, bool shown);
  void _describe();

  Evas_Object* _layout = nullptr;
  Evas_Object* _back = nullptr;
  Evas_Object* _progress = nullptr;
  std::vector<Evas_Object*> _buttons;
  std::string _summary;
  std::string _emptyText;
  bool _isEmpty = false;
  std::unique_ptr<ListView> _list;
};

}  // namespace companion
