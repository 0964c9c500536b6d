/// What the tests of a page that changes while it is open have in common.
#pragma once

#include <gtest/gtest.h>

#include <string>

#include "Companions.h"
#include "Picture.h"

constexpr const char* kThumbnails = "/opt/usr/apps/com.orlant.zelqo/shared/data/thumbnail";
constexpr const char* kMidThumbnails =
    "/opt/usr/apps/com.orlant.zelqo/shared/data/fullview_thumbnail";

/// Leaves the phone as it was found.
class AlivePage : public testing::Test {
 protected:
  void TearDown() override;
};

std::string serviceAddress();
/// Where the service keeps a file of a share; kind is file, thumb or mid.
std::string addressOf(const phone::Share& share, const std::string& kind, int file);
/// What the service counted: its own JSON text.
std::string serviceStats();
/// One number of it.
long serviceCount(const std::string& kind);

std::string writtenFile(const std::string& name, const std::string& content);
/// A share that consists of this JSON array.
phone::Share announced(const std::string& files);

size_t filesIn(const std::string& folder);
std::string viewerProcess();

/// Waits for that colour in the middle of the cell.
testing::AssertionResult cellShows(const std::string& name, const phone::Colour& colour);
/// Waits until the cell's name tells this state: downloading, downloaded, ...
testing::AssertionResult cellIs(const std::string& name, const std::string& state);
testing::AssertionResult downloadIsEnabled(bool isEnabled);
