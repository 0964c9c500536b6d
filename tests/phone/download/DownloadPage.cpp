#include "DownloadPage.h"

#include <filesystem>
#include <sstream>

#include "Transfers.h"
#include "User.h"

namespace fs = std::filesystem;
using phone::Share;
using phone::thePhone;
using phone::waitFor;
using phone::Words;

namespace {

bool endsWith(const std::string& text, const std::string& end) {
  return text.size() >= end.size() && text.compare(text.size() - end.size(), end.size(), end) == 0;
}

}  // namespace

void DownloadPage::SetUp() {
  // One that is still there would take the taps on the title bar.
  thePhone()({"shell", "dunstctl", "close-all"});
  _launches = handOvers().size();
  _records = usageRecords().size();
  _messages = thePhone()({"messages"}).size();
  errorsCountFromHere();
}

void DownloadPage::TearDown() {
  thePhone()({"service", "ok"});
  thePhone()({"network", "wifi"});
  thePhone()({"language", "en_US.UTF-8"});
  thePhone().closeViewer();
  killDownloadApplication();
  for (const auto& entry : fs::directory_iterator(ofPhone(kFolder))) fs::remove_all(entry);
}

std::vector<HandOver> DownloadPage::newHandOvers() const {
  auto all = handOvers();
  all.erase(all.begin(), all.begin() + static_cast<std::ptrdiff_t>(_launches));
  return all;
}

Words DownloadPage::newRecords() const {
  auto all = usageRecords();
  all.erase(all.begin(), all.begin() + static_cast<std::ptrdiff_t>(_records));
  return all;
}

testing::AssertionResult DownloadPage::saysNow(const std::string& text) const {
  std::string said;
  const bool came = waitFor([&] {
    said = thePhone()({"messages"}).substr(_messages);
    return said.find(text) != std::string::npos;
  });
  if (came) return testing::AssertionSuccess();
  return testing::AssertionFailure() << "never said: " << text << "\nbut\n" << said;
}

HandOver DownloadPage::handedOver() const {
  EXPECT_TRUE(waitFor([&] { return newHandOvers().size() == 1; })) << newHandOvers().size();
  const auto all = newHandOvers();
  return all.empty() ? HandOver() : all.back();
}

void DownloadPage::errorsCountFromHere() {
  _log = thePhone().log().size();
}

Words DownloadPage::newErrors() const {
  Words errors;
  std::istringstream log(thePhone().log().substr(_log));
  for (std::string line; std::getline(log, line);) {
    if (line.find("E/ZQ_VIEWER") != std::string::npos) errors.push_back(line);
  }
  return errors;
}

Words papers(int count) {
  Words files;
  for (int i = 1; i <= count; i++) {
    files.push_back(
        thePhone().makeFile("Paper " + std::to_string(i) + ".txt", 100 * static_cast<size_t>(i)));
  }
  return files;
}

testing::AssertionResult selectFrom(const Share& share) {
  thePhone().launchReceived(share.token);
  const auto tapped = tap("Download");
  return tapped ? titleIs(kNoFilesSelected) : tapped;
}

testing::AssertionResult tapInPopup(const std::string& button) {
  std::string centre;
  const bool came = waitFor([&] {
    const auto tree = thePhone().tree();
    if (tree.withRole("dialog").empty()) return false;
    for (const auto& widget : tree.withRole("push button")) {
      if (widget.name == button) centre = centreOf(widget);
    }
    return !centre.empty();
  });
  if (came) thePhone()({"tap", centre});
  return seen(thePhone(), came, "no popup with \"" + button + "\"");
}

testing::AssertionResult titleIs(const std::string& title) {
  return seen(thePhone(), waitFor([&] {
                const auto pages = thePhone().tree().withRole("page tab");
                return !pages.empty() && pages.back().name == title;
              }),
              "no page \"" + title + "\"");
}

Words selectedItems() {
  Words names;
  for (const auto& item : thePhone().tree().items()) {
    if (endsWith(item.name, ", selected")) names.push_back(item.name);
  }
  return names;
}

std::string stored(const std::string& name) {
  return ofPhone(std::string(kFolder) + "/" + name);
}

size_t downloadedCells() {
  size_t count = 0;
  for (const auto& item : thePhone().tree().items()) {
    count += endsWith(item.name, ", downloaded");
  }
  return count;
}

testing::AssertionResult downloadedCellsAre(size_t count) {
  return seen(thePhone(), waitFor([=] { return downloadedCells() == count; }),
              "not " + std::to_string(count) + " downloaded cells");
}
