/// What the tests of selecting and downloading have in common.
#pragma once

#include <gtest/gtest.h>

#include <string>

#include "AlivePage.h"
#include "HandOver.h"

constexpr const char* kFolder = "/opt/usr/media/Downloads";
constexpr const char* kNoFilesSelected = "Select items";
constexpr const char* kNoNetwork = "Mobile data is turned off";
constexpr const char* kNoWifi = "Wi-Fi is not available";

/// Tells what has been added since the test began, and leaves the phone as it was found.
class DownloadPage : public testing::Test {
 protected:
  void SetUp() override;
  void TearDown() override;

  std::vector<HandOver> newHandOvers() const;
  phone::Words newRecords() const;
  /// Waits for a status-bar message of this test that contains the text.
  testing::AssertionResult saysNow(const std::string& text) const;
  /// Waits until the viewer has handed over once; that request.
  HandOver handedOver() const;
  /// Critical lines of the viewer's log since errorsCountFromHere().
  phone::Words newErrors() const;
  void errorsCountFromHere();

 private:
  size_t _launches = 0;
  size_t _records = 0;
  size_t _messages = 0;
  size_t _log = 0;
};

/// "Paper 1.txt" and so on, each a little larger than the one before.
phone::Words papers(int count);

/// Opens the received share and its select page.
testing::AssertionResult selectFrom(const phone::Share& share);
/// Taps the button of that name in the popup; the page behind it may have one, too.
testing::AssertionResult tapInPopup(const std::string& button);
/// Waits until the page has that title.
testing::AssertionResult titleIs(const std::string& title);
/// Names of the cells and rows that are selected.
phone::Words selectedItems();

std::string stored(const std::string& name);
/// How many cells of the page say that they are downloaded.
size_t downloadedCells();
testing::AssertionResult downloadedCellsAre(size_t count);
