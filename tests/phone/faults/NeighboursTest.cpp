// Every neighbour is killed, or frozen, while the viewer is on each of its main ways: it never
// waits for anybody longer than a second, does not crash, loses nothing, and goes on where it was
// when the neighbour is there again. FAULTS=all tries each with each; otherwise it is those where
// most can go wrong.

#include <fstream>

#include "Companions.h"
#include "FullPage.h"
#include "Journey.h"
#include "Neighbour.h"

using phone::Share;
using phone::thePhone;
using phone::waitFor;
using phone::Words;

namespace {

constexpr std::chrono::milliseconds kLongestWait{1000};
/// Whoever waits for a second has been found out by then.
constexpr std::chrono::milliseconds kObserved{1300};
constexpr const char* kFriend = "+821011112222";
constexpr const char* kOwnNumber = "+821012345678";

enum class Way { Receive, Page, Download, Open, Recall, Reshare };
constexpr const char* kWayNames[] = {"Receive", "Page", "Download", "Open", "Recall", "Reshare"};

struct Trouble {
  const Neighbour* neighbour;
  Harm harm;
  Way way;
};

std::string nameOf(const Trouble& trouble) {
  return trouble.neighbour->name + (trouble.harm == Harm::Kill ? "Killed" : "Frozen") + "On" +
         kWayNames[static_cast<int>(trouble.way)];
}

std::ostream& operator<<(std::ostream& out, const Trouble& trouble) {
  return out << nameOf(trouble);
}

/// Nothing can be launched over a bus that is frozen, and without one there is no phone at all.
bool makesSense(const Trouble& trouble) {
  if (trouble.neighbour != &neighbour::kSessionBus) return true;
  return trouble.harm == Harm::Freeze && trouble.way != Way::Receive;
}

std::vector<Trouble> allTroubles() {
  using namespace neighbour;
  std::vector<Trouble> troubles;
  for (const auto* neighbour : {&kService, &kAgent, &kContacts, &kSessionBus, &kSystemBus,
                                &kNotifications, &kDownloadManager, &kSignUpPage, &kWorld}) {
    for (const auto harm : {Harm::Freeze, Harm::Kill}) {
      for (const auto way :
           {Way::Receive, Way::Page, Way::Download, Way::Open, Way::Recall, Way::Reshare}) {
        if (makesSense({neighbour, harm, way})) troubles.push_back({neighbour, harm, way});
      }
    }
  }
  return troubles;
}

std::vector<Trouble> chosenTroubles() {
  using namespace neighbour;
  if (getenv("FAULTS")) return allTroubles();
  return {
      {&kContacts, Harm::Freeze, Way::Receive},   {&kContacts, Harm::Kill, Way::Reshare},
      {&kSystemBus, Harm::Freeze, Way::Receive},  {&kSystemBus, Harm::Kill, Way::Download},
      {&kSessionBus, Harm::Freeze, Way::Open},    {&kDownloadManager, Harm::Freeze, Way::Download},
      {&kService, Harm::Freeze, Way::Recall},     {&kAgent, Harm::Kill, Way::Receive},
      {&kNotifications, Harm::Freeze, Way::Open}, {&kSignUpPage, Harm::Freeze, Way::Recall}};
}

std::string viewerProcess() {
  return thePhone().processesOf({"zelqo-viewer"});
}

class Neighbours : public testing::TestWithParam<Trouble> {
 protected:
  void SetUp() override {
    for (const char* application : {"com.orlant.myfile-download-manager", "com.orlant.ovuport"}) {
      ::open(application);
    }
    const std::string file = thePhone().makeFile("File 1.txt", 0);
    std::ofstream(file) << "A text that a program for texts opens.\n";
    _received = thePhone().share({file});
    _sent = thePhone().shareTo(kFriend, kOwnNumber, {file});
  }
  void TearDown() override {
    thePhone()({"service", "ok"});
    thePhone().closeViewer();
    thePhone().end({"l3afpad", "contacts-picker", "download-manager", "ovuport"});
  }

  void launch() const {
    const bool isSent = GetParam().way == Way::Recall || GetParam().way == Way::Reshare;
    if (isSent) {
      thePhone()({"launch", "sent", "--request", std::to_string(_sent.request)});
    } else {
      thePhone().launchReceived(_received.token);
    }
  }

  /// Up to where the way begins.
  void prepare() {
    const Way way = GetParam().way;
    if (way == Way::Receive) return;
    launch();
    ASSERT_TRUE(comes("File 1.txt"));
    if (way != Way::Open) return;
    thePhone()({"tap", place::kFirstCell});
    ASSERT_TRUE(pageIs("File 1.txt"));
    _watch.rest();
    ASSERT_TRUE(thePhone().tree().named("Open") || download());
  }

  void act() {
    switch (GetParam().way) {
      case Way::Receive:
        launch();
        break;
      case Way::Page:
        touch({place::kFirstCell});
        break;
      case Way::Download:
        touch({place::kBottomButton, place::kSelectAll, place::kDone});
        break;
      case Way::Open:
        touch({place::kBottomButton});
        break;
      case Way::Recall:
        touch({place::kRecall, place::kOk});
        break;
      case Way::Reshare:
        touch({place::kReshare});
        break;
    }
  }
  void touch(const Words& places) {
    for (const std::string& place : places) {
      _watch.tap(place);
      EXPECT_NE(_watch.rest(), "silent");
    }
  }

  /// Lets the viewer go on for a while.
  void observe() {
    const auto end = std::chrono::steady_clock::now() + kObserved;
    while (std::chrono::steady_clock::now() < end) {
      if (_watch.settle() == "gone") return;
    }
  }

  static bool isThere(const std::string& name) { return thePhone().tree().named(name) != nullptr; }
  static bool hasEnded(const std::string& program) {
    return thePhone().processesOf({program}).empty();
  }

  /// Whether the way has led where it should.
  bool hasArrived() const {
    switch (GetParam().way) {
      case Way::Receive:
        return isThere("Download") && isThere("File 1.txt");
      case Way::Page:
        return pageOn(thePhone().tree()).rfind("File 1.txt, ", 0) == 0;
      case Way::Download:
        return thePhone().tree().text().find(", text, downloaded") != std::string::npos;
      case Way::Open:
        return !hasEnded("l3afpad");
      case Way::Recall:
        return hasEnded("zelqo-viewer");
      case Way::Reshare:
        return isThere("Select recipients");
    }
    return false;
  }

  Share _received, _sent;
  LoopWatch _watch;
};

}  // namespace

TEST_P(Neighbours, MayHangOrGo) {
  prepare();
  const std::string before = viewerProcess();
  {
    const Harmed harmed(*GetParam().neighbour, GetParam().harm);
    _watch.begin();
    act();
    observe();
    EXPECT_LE(_watch.longestWait().count(), kLongestWait.count());
  }
  // What failed while the neighbour was away can be asked for again.
  if (!waitFor([&] { return hasArrived(); }, std::chrono::seconds(3))) {
    launch();
    prepare();
    act();
    EXPECT_TRUE(waitFor([&] { return hasArrived(); })) << thePhone().tree();
  }
  const std::string after = viewerProcess();
  EXPECT_TRUE(before.empty() || after.empty() || before == after) << "the viewer was started anew";
}

INSTANTIATE_TEST_SUITE_P(Troubles, Neighbours, testing::ValuesIn(chosenTroubles()),
                         [](const auto& info) { return nameOf(info.param); });
