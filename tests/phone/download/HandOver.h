/// What leaves the viewer when files are downloaded: launch requests and usage records.
#pragma once

#include <string>
#include <utility>
#include <vector>

#include "Phone.h"

/// The extras of a launch request in their order; a text is a list of one.
using Extras = std::vector<std::pair<std::string, phone::Words>>;

struct HandOver {
  std::string application, operation;
  Extras extras;

  /// Nothing when there is no such extra.
  phone::Words operator[](const std::string& key) const;
};

/// All launch requests of the viewer since the phone is up.
std::vector<HandOver> handOvers();

/// All usage records since the phone is up, as "ZQ52 1_10".
phone::Words usageRecords();
