/// What the tests of the full page have in common: one file of a share on the whole screen.
#pragma once

#include <gtest/gtest.h>

#include <string>

#include "Companions.h"
#include "Picture.h"

/// Leaves the phone as it was found.
class FullPage : public testing::Test {
 protected:
  void TearDown() override;
};

/// "File 1.txt" and so on, as many as asked for.
phone::Words numberedFiles(int count);

/// Shares the files with this phone, opens the share and taps the cell of that name.
void openReceived(const phone::Words& files, const std::string& cell);
/// The same as their sender.
void openSent(const phone::Words& files, const std::string& cell);

/// The accessible name of the file whose page fills the pager; empty while none does.
std::string pageOn(const phone::Tree& tree);
/// Where that page is; nowhere while none fills the pager.
phone::Area pageArea(const phone::Tree& tree);
/// Waits until that file is the page and nothing moves any more.
testing::AssertionResult pageIs(const std::string& name);

/// The same by its place, from 1.
testing::AssertionResult pageNumberIs(size_t number);

void swipeForth();
void swipeBack();

/// Waits until a button of that name is there and enabled, or there and disabled.
testing::AssertionResult buttonIsEnabled(const std::string& name);
testing::AssertionResult buttonIsDisabled(const std::string& name);

/// Downloads the file on screen from here.
testing::AssertionResult download();

/// Ends the programs that show files; false when there was none.
bool closePrograms();

size_t countOf(const std::string& text, const std::string& part);
/// Does a tap on Open bring one more message that no application was found?
testing::AssertionResult openIsRefused();
