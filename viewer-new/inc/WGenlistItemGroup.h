#pragma once

#include "WGenlistItemMonoline.h"

/// The heading above a group of rows.
class WGenlistItemGroup : public WGenlistItemMonoline {
 public:
  using WGenlistItemMonoline::WGenlistItemMonoline;

  Elm_Genlist_Item_Class* getItemClass() override;
  const char* getClassName() override;
  void* onWrap(void* content) override;
};
