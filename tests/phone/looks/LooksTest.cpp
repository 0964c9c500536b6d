// Every page and popup, on screens of three sizes, upright and lying: no text is cut off, hidden,
// overlaid or an identifier, and what has to be there is there. In every language on the screen
// that most phones have, upright; otherwise in those with the longest words, the tallest letters
// and the other direction. With the largest text, lines may end in dots, and nothing else changes.

#include <filesystem>
#include <set>

#include "FullPage.h"

namespace fs = std::filesystem;
using phone::thePhone;
using phone::Words;

namespace {

constexpr const char* kOwnNumber = "+821012345678";
constexpr const char* kFriend = "+821011112222";
constexpr const char* kOther = "+821033334444";
constexpr const char* kMiddleScreen = "720x1280";
constexpr const char* kHardestLanguages = "ar de ja ru";
/// The largest that the settings offer.
constexpr const char* kLargestText = "200";

struct Shares {
  std::string single, expired;
  long sent = 0, sentToTwo = 0;
};

Shares& shares() {
  static Shares all;
  return all;
}

Words files() {
  Words all;
  for (const char* name : {"a.txt", "写真.pdf", "사진.zip", "फ़ोटो.mp3", "צילום.jpg", "صور.docx"}) {
    all.push_back(thePhone().makeFile(name));
  }
  all.push_back(thePhone().makeFile("g.bin", 7000000));  // more than is downloaded unasked
  return all;
}

/// So that whatever the session bus starts from now on has the probe in it.
void insertProbe() {
  const char* asan = getenv("ASAN_OPTIONS");
  const std::string environment = "{'LD_PRELOAD': '" PROBE "', 'ASAN_OPTIONS': '" +
                                  std::string(asan ? asan : "") + ":verify_asan_link_order=0'}";
  thePhone()({"shell", "gdbus", "call", "--session", "--dest", "org.freedesktop.DBus",
              "--object-path", "/org/freedesktop/DBus", "--method",
              "org.freedesktop.DBus.UpdateActivationEnvironment", environment});
}

void startPhone(const std::string& screen) {
  static std::string started;
  if (started == screen) return;
  started = screen;
  phone::thePhoneWith({"--screen", screen});
  insertProbe();
  thePhone()({"contact", "add", "Ann", kFriend});
  shares().single = thePhone().share(files(), {"--single"}).token;
  shares().expired = thePhone().share(files(), {"--expires-in", "1"}).token;
  shares().sent = thePhone().shareTo(kFriend, kOwnNumber, files()).request;
  shares().sentToTwo =
      thePhone().shareTo(std::string(kFriend) + "," + kOther, kOwnNumber, files()).request;
}

void openReceived() {
  thePhone()({"launch", "received", "--token", shares().single, "--single"});
  ASSERT_TRUE(comes("a.txt"));
}

void openSelection() {
  openReceived();
  ASSERT_TRUE(tap("Download"));
  ASSERT_TRUE(comes("Select all"));
}

void selectAll() {
  openSelection();
  ASSERT_TRUE(tap("Select all"));
  ASSERT_TRUE(comes("7 selected"));
}

void askForWifi() {
  selectAll();
  ASSERT_TRUE(tap("Done"));
  ASSERT_TRUE(comes("Download via Wi-Fi only"));
}

void openFull() {
  openReceived();
  ASSERT_TRUE(tap("a.txt"));
  ASSERT_TRUE(pageIs("a.txt"));
}

void openDownloaded() {
  openFull();
  ASSERT_TRUE(tap("Download"));
  ASSERT_TRUE(comes("Open"));
}

void missDownloaded() {
  openDownloaded();
  fs::remove(ofPhone("/opt/usr/media/Downloads/a.txt"));
  ASSERT_TRUE(tap("Open"));
  ASSERT_TRUE(comes("The file was deleted"));
}

void openSent(long request) {
  thePhone()({"launch", "sent", "--request", std::to_string(request)});
  ASSERT_TRUE(comes("a.txt"));
}

void askForRecall() {
  openSent(shares().sent);
  ASSERT_TRUE(tap("Recall"));
  ASSERT_TRUE(comes("OK"));
}

void recall() {
  askForRecall();
  thePhone()({"service", "slow", "60000"});
  ASSERT_TRUE(tap("OK"));
  ASSERT_TRUE(comes("Recalling"));
}

void openExpired() {
  thePhone().launchReceived(shares().expired);
  ASSERT_TRUE(comes("This share has expired"));
}

struct Page {
  const char* name;
  void (*open)();
  Words messages;
  const char* beginsAtTheMargin = "";
};

void PrintTo(const Page& page, std::ostream* out) {
  *out << page.name;
}

constexpr const char* kTitle = "IDS_RSH_HEADER_FILES_SHARED_BY_PS_ABB";
constexpr const char* kDownload = "IDS_RSH_BUTTON_DOWNLOAD_ABB3";
constexpr const char* kCancel = "IDS_RSH_BUTTON_CANCEL_ABB2";
constexpr const char* kSelectAll = "IDS_RSH_OPT_SELECT_ALL";
constexpr const char* kSelectCancel = "IDS_TPLATFORM_ACBUTTON_CANCEL_ABB";
constexpr const char* kDone = "IDS_TPLATFORM_ACBUTTON_DONE_ABB";
constexpr const char* kRecall = "IDS_RSH_BUTTON_RECALL_ABB";
constexpr const char* kReshare = "IDS_RSH_BUTTON_RESHARE_ABB";
constexpr const char* kShared = "IDS_RSH_HEADER_SHARED_FILES_ABB";
constexpr const char* kExpiry = "IDS_RSH_BODY_EXPIRED_ON_PS";
constexpr const char* kCount = "IDS_RSH_SBODY_P1SD_FILES_HP2SS_P3SS_ABB";
constexpr const char* kLater =
    "IDS_RSH_BODY_TO_DOWNLOAD_THESE_FILES_LATER_GO_TO_MY_FILES_SHARING_HISTORY_THEN_SELECT_THIS_"
    "MESSAGE";
constexpr const char* kGone =
    "IDS_RSH_POP_THE_FILE_WAS_DELETED_MOVED_OR_RENAMED_DOWNLOAD_THE_FILE_AND_TRY_AGAIN";

const Page kPages[] = {
    {"Received", openReceived, {kTitle, kCount, kExpiry, kLater, kDownload}, kExpiry},
    {"Selection",
     openSelection,
     {"IDS_RSH_HEADER_SELECT_ITEMS_ABB3", kSelectAll, kSelectCancel, kDone},
     kSelectAll},
    {"Selected", selectAll, {"IDS_RSH_HEADER_PD_SELECTED_ABB", kSelectAll, kSelectCancel, kDone}},
    // The label is meant to say this after a change of the language.
    {"WifiPopup",
     askForWifi,
     {"IDS_RSH_HEADER_DOWNLOAD_FILES", kGone, "IDS_RSH_OPT_DOWNLOAD_VIA_WI_FI_ONLY_ABB", kCancel,
      kDownload},
     kGone},
    {"Full", openFull, {kDownload}},
    {"Downloaded", openDownloaded, {"IDS_RSH_BUTTON_OPEN"}},
    {"UnableToOpenPopup",
     missDownloaded,
     {"IDS_RSH_HEADER_UNABLE_TO_OPEN_FILE_ABB", kGone, kCancel, kDownload},
     kGone},
    {"Sent",
     [] { openSent(shares().sent); },
     {kShared, "IDS_RSH_HEADER_RECIPIENT", kRecall, kReshare},
     "IDS_RSH_HEADER_RECIPIENT"},
    {"SentToTwo",
     [] { openSent(shares().sentToTwo); },
     {kShared, "IDS_RSH_HEADER_RECIPIENTS_HPD_ABB", kRecall, kReshare},
     "IDS_RSH_HEADER_RECIPIENTS_HPD_ABB"},
    {"RecallPopup",
     askForRecall,
     {kRecall, "IDS_RSH_POP_THE_RECIPIENT_WILL_NO_LONGER_BE_ABLE_TO_DOWNLOAD_THE_FILES", kCancel,
      "IDS_RSH_BUTTON_OK"}},
    {"RecallingPopup", recall, {"IDS_RSH_POP_RECALLING_FILES_ING"}},
    {"Expired",
     openExpired,
     {kTitle, kCount, kExpiry, "IDS_RSH_NPBODY_SHARED_MESSAGE_EXPIRED", kDownload},
     kExpiry},
};

/// The rest is built like one of these.
std::vector<Page> pagesOnOtherScreens() {
  std::vector<Page> all;
  const std::set<std::string> alike{"Selection", "Downloaded", "SentToTwo", "RecallPopup"};
  for (const Page& page : kPages) {
    if (alike.count(page.name) == 0) all.push_back(page);
  }
  return all;
}

using Place = std::tuple<const char*, Page>;

std::string nameOf(const testing::TestParamInfo<Place>& place) {
  return std::string(std::get<Page>(place.param).name) + "_" + std::get<const char*>(place.param);
}

class Looks : public testing::TestWithParam<Place> {
 protected:
  std::string screen() const { return std::get<const char*>(GetParam()); }
  const Page& page() const { return std::get<Page>(GetParam()); }

  void SetUp() override { startPhone(screen()); }
  void TearDown() override {
    thePhone()({"service", "ok"});
    thePhone()({"rotate", "0"});
    thePhone().closeViewer();
    thePhone()({"language", "en_US.UTF-8"});
    for (const auto& file : fs::directory_iterator(ofPhone("/opt/usr/media/Downloads"))) {
      fs::remove_all(file);
    }
  }

  /// What is wrong with the page as it is now, in any of the languages.
  std::string complaints(const std::string& turned) const {
    Words words = {"shell", CHECK};
    if (turned == "larger") {
      words.insert(words.end(), {"--larger", "--languages", "de"});
    } else if (screen() != kMiddleScreen || turned == "lying") {
      words.insert(words.end(), {"--languages", kHardestLanguages});
    } else {
      fs::create_directories(PICTURES);
      words.insert(words.end(), {"--pictures", std::string(PICTURES "/") + page().name});
    }
    // The sheet of a popup does not fill a phone that lies.
    if (*page().beginsAtTheMargin && turned == "upright") {
      words.insert(words.end(), {"--begins", page().beginsAtTheMargin});
    }
    words.insert(words.end(), page().messages.begin(), page().messages.end());
    return thePhone()(words);
  }
};

}  // namespace

TEST_P(Looks, AreRightInTheLanguages) {
  page().open();
  if (HasFatalFailure()) return;
  EXPECT_EQ(complaints("upright"), "");
  if (screen() == kMiddleScreen) {
    thePhone()({"textsize", kLargestText});
    EXPECT_EQ(complaints("larger"), "");
    thePhone()({"textsize", "100"});
  }
  thePhone()({"rotate", "90"});
  EXPECT_EQ(complaints("lying"), "");
}

INSTANTIATE_TEST_SUITE_P(MiddleScreen, Looks,
                         testing::Combine(testing::Values(kMiddleScreen),
                                          testing::ValuesIn(kPages)),
                         nameOf);
INSTANTIATE_TEST_SUITE_P(OtherScreens, Looks,
                         testing::Combine(testing::Values("480x800", "1080x1920"),
                                          testing::ValuesIn(pagesOnOtherScreens())),
                         nameOf);

TEST(Letters, OfAllLanguagesAreOfOneFamily) {
  for (const char* letter : {"61", "44f", "5d0", "627", "905", "3042", "4e2d", "ac00"}) {
    const std::string family = phone::thePhone()(
        {"shell", "fc-match", "-f", "%{family}", "Noto Sans:charset=" + std::string(letter)});
    EXPECT_EQ(family.rfind("Noto Sans", 0), 0u) << letter << " is drawn with " << family;
  }
}
