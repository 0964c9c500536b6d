// Every language of every catalogue, looked up the way the applications do.
#include <glib.h>
#include <gtest/gtest.h>
#include <libintl.h>
#include <printf.h>
#include <unicode/ubidi.h>
#include <unicode/unistr.h>

#include <array>
#include <clocale>
#include <cstdlib>
#include <cstring>
#include <memory>
#include <string>
#include <vector>

extern "C" int _nl_msg_cat_cntr;  // gettext's own: counts up when its answers may have changed

namespace {

constexpr const char* kViewer = "zelqo";
constexpr const char* kPlatform = "sys_string";
constexpr std::array kLanguages{"en", "de", "fr",    "es", "pt", "ru",
                                "ko", "ja", "zh_CN", "ar", "he", "hi"};

struct Domain {
  const char* name;
  const char* folder;
};
constexpr std::array kDomains{
    Domain{kViewer, IMAGE_DIR "/apps/com.orlant.zelqo/res/locale"},
    Domain{kPlatform, IMAGE_DIR "/share/locale"},
};

/// An identifier and the printf arguments its callers pass: s for text, d for int.
struct Message {
  const char* domain;
  const char* id;
  const char* arguments = "";
};

const std::vector<Message> kMessages{
    {kViewer, "IDS_RSH_HEADER_FILES_SHARED_BY_PS_ABB", "s"},
    {kViewer, "IDS_RSH_SBODY_1_FILE_HP1SS_P2SS_ABB", "ss"},
    {kViewer, "IDS_RSH_SBODY_P1SD_FILES_HP2SS_P3SS_ABB", "dss"},
    {kViewer, "IDS_RSH_BODY_EXPIRED_ON_PS", "s"},
    {kViewer,
     "IDS_RSH_BODY_TO_DOWNLOAD_THIS_FILE_LATER_GO_TO_MY_FILES_SHARING_HISTORY_THEN_SELECT_THIS_"
     "MESSAGE"},
    {kViewer,
     "IDS_RSH_BODY_TO_DOWNLOAD_THESE_FILES_LATER_GO_TO_MY_FILES_SHARING_HISTORY_THEN_SELECT_THIS_"
     "MESSAGE"},
    {kViewer, "IDS_RSH_NPBODY_SHARED_MESSAGE_EXPIRED"},
    {kViewer, "IDS_RSH_HEADER_SELECT_ITEMS_ABB3"},
    {kViewer, "IDS_RSH_HEADER_PD_SELECTED_ABB", "d"},
    {kViewer, "IDS_RSH_OPT_SELECT_ALL"},
    {kViewer, "IDS_TPLATFORM_ACBUTTON_CANCEL_ABB"},
    {kPlatform, "IDS_TPLATFORM_ACBUTTON_CANCEL_ABB"},
    {kViewer, "IDS_TPLATFORM_ACBUTTON_DONE_ABB"},
    {kPlatform, "IDS_TPLATFORM_ACBUTTON_DONE_ABB"},
    {kViewer, "IDS_RSH_HEADER_SHARED_FILES_ABB"},
    {kViewer, "IDS_RSH_HEADER_RECIPIENT"},
    {kViewer, "IDS_RSH_HEADER_RECIPIENTS_HPD_ABB", "d"},
    {kViewer, "IDS_RSH_BUTTON_DOWNLOAD_ABB3"},
    {kViewer, "IDS_RSH_BUTTON_OPEN"},
    {kViewer, "IDS_RSH_BUTTON_RECALL_ABB"},
    {kViewer, "IDS_RSH_BUTTON_RESHARE_ABB"},
    {kViewer, "IDS_RSH_BUTTON_CANCEL_ABB2"},
    {kViewer, "IDS_RSH_BUTTON_OK"},
    {kViewer, "IDS_RSH_HEADER_DOWNLOAD_FILES"},
    {kViewer, "IDS_RSH_POP_THE_TOTAL_FILE_SIZE_IS_OVER_P1SS_P2SS_TO_AVOID_MSG", "ss"},
    {kViewer, "IDS_RSH_OPT_DOWNLOAD_VIA_WI_FI_ONLY_ABB"},
    {kViewer, "IDS_RSH_HEADER_UNABLE_TO_OPEN_FILE_ABB"},
    {kViewer, "IDS_RSH_POP_THE_FILE_WAS_DELETED_MOVED_OR_RENAMED_DOWNLOAD_THE_FILE_AND_TRY_AGAIN"},
    {kViewer, "IDS_RSH_POP_THE_RECIPIENT_WILL_NO_LONGER_BE_ABLE_TO_DOWNLOAD_THE_FILES"},
    {kViewer, "IDS_RSH_POP_RECALLING_FILES_ING"},
    {kViewer, "IDS_RSH_TPOP_COULDNT_RECALL_FILE_TRY_AGAIN"},
    {kViewer, "IDS_RSH_TPOP_UNABLE_TO_FIND_APPLICATION_TO_PERFORM_THIS_ACTION"},
    {kViewer, "IDS_RSH_TPOP_WI_FI_NOT_AVAILABLE_TURN_ON_WI_FI_OR_DESELECT_DOWNLOAD_VIA_WI_FI_ONLY"},
    {kPlatform, "IDS_MF_POP_MOBILE_DATA_IS_TURNED_OFF_CONNECT_TO_A_WI_FI_NETWORK_INSTEAD_MSG"},
};

const char* const kDownloadButton = "IDS_RSH_BUTTON_DOWNLOAD_ABB3";
const char* const kWifiOnlyCheck = "IDS_RSH_OPT_DOWNLOAD_VIA_WI_FI_ONLY_ABB";
const char* const kWifiMissing =
    "IDS_RSH_TPOP_WI_FI_NOT_AVAILABLE_TURN_ON_WI_FI_OR_DESELECT_DOWNLOAD_VIA_WI_FI_ONLY";

/// The argument letters of a format; '?' for anything that is neither text nor int.
std::string argumentsOf(const char* format) {
  std::array<int, 8> types{};
  const size_t count = parse_printf_format(format, types.size(), types.data());
  std::string letters;
  for (size_t i = 0; i < count && i < types.size(); ++i) {
    letters += types[i] == PA_STRING ? 's' : types[i] == PA_INT ? 'd' : '?';
  }
  return strstr(format, "%n") ? letters + '?' : letters;
}

/// Columns of a fixed-width screen: what stands above or below another letter takes none.
int columns(const char* text) {
  int sum = 0;
  for (const char* at = text; *at; at = g_utf8_next_char(at)) {
    const gunichar letter = g_utf8_get_char(at);
    if (!g_unichar_iszerowidth(letter)) sum += g_unichar_iswide(letter) ? 2 : 1;
  }
  return sum;
}

/// The letters from left to right, as a screen shows a line of their direction.
std::string fromLeftToRight(const icu::UnicodeString& letters) {
  UErrorCode status = U_ZERO_ERROR;
  const std::unique_ptr<UBiDi, decltype(&ubidi_close)> order(ubidi_open(), ubidi_close);
  ubidi_setPara(order.get(), letters.getBuffer(), letters.length(), UBIDI_DEFAULT_LTR, nullptr,
                &status);
  std::vector<UChar> shown(letters.length() + 1);
  const int length = ubidi_writeReordered(order.get(), shown.data(), letters.length(),
                                          UBIDI_REMOVE_BIDI_CONTROLS, &status);
  std::string text;
  return icu::UnicodeString(shown.data(), length).toUTF8String(text);
}

class Catalogue : public testing::TestWithParam<const char*> {
 protected:
  static void SetUpTestSuite() {
    // In the plain C locale gettext translates nothing; in this one it follows LANGUAGE.
    ASSERT_TRUE(setlocale(LC_ALL, "C.UTF-8"));
    for (const Domain& domain : kDomains) {
      bindtextdomain(domain.name, domain.folder);
      bind_textdomain_codeset(domain.name, "UTF-8");
    }
  }

  void SetUp() override {
    setenv("LANGUAGE", GetParam(), 1);
    ++_nl_msg_cat_cntr;
  }

  static std::string text(const char* id) { return dgettext(kViewer, id); }
  bool isReadFromTheRight() const {
    return strcmp(GetParam(), "ar") == 0 || strcmp(GetParam(), "he") == 0;
  }
};

TEST_P(Catalogue, TranslatesEveryIdentifier) {
  for (const Message& message : kMessages) {
    const char* text = dgettext(message.domain, message.id);
    EXPECT_STRNE(text, message.id) << message.domain;
    EXPECT_STRNE(text, "") << message.domain << ' ' << message.id;
    EXPECT_EQ(strstr(text, "IDS_"), nullptr) << message.domain << ' ' << message.id;
  }
}

TEST_P(Catalogue, TakesExactlyTheArgumentsThatTheCallersPass) {
  for (const Message& message : kMessages) {
    EXPECT_EQ(argumentsOf(dgettext(message.domain, message.id)), message.arguments)
        << message.domain << ' ' << message.id;
  }
}

TEST_P(Catalogue, IsUtf8InItsOwnLanguage) {
  const std::string language = std::string("Language: ") + GetParam() + "\n";
  for (const Domain& domain : kDomains) {
    const char* header = dgettext(domain.name, "");
    EXPECT_NE(strstr(header, "charset=UTF-8"), nullptr) << domain.name;
    EXPECT_NE(strstr(header, language.c_str()), nullptr) << domain.name;
  }
  for (const Message& message : kMessages) {
    EXPECT_TRUE(g_utf8_validate(dgettext(message.domain, message.id), -1, nullptr)) << message.id;
  }
}

TEST_P(Catalogue, HoldsNoMarkup) {
  for (const Message& message : kMessages) {
    EXPECT_EQ(strpbrk(dgettext(message.domain, message.id), "<>&"), nullptr) << message.id;
  }
}

// The pages format into buffers of 512 bytes; 100 are left for what the arguments bring.
TEST_P(Catalogue, FitsTheBuffersOfThePages) {
  for (const Message& message : kMessages) {
    EXPECT_LE(strlen(dgettext(message.domain, message.id)), 412u) << message.id;
  }
}

// Summary, day and hint share 1024 bytes with their markup and the arguments.
TEST_P(Catalogue, LeavesRoomForTheHintUnderTheSummary) {
  const size_t above = text("IDS_RSH_SBODY_P1SD_FILES_HP2SS_P3SS_ABB").size() +
                       text("IDS_RSH_BODY_EXPIRED_ON_PS").size();
  for (const Message& message : kMessages) {
    if (!strstr(message.id, "_LATER_GO_TO_MY_FILES_")) continue;
    EXPECT_LE(above + text(message.id).size(), 760u) << message.id;
  }
}

TEST_P(Catalogue, KeepsButtonsShort) {
  for (const Message& message : kMessages) {
    if (!strstr(message.id, "BUTTON_")) continue;
    EXPECT_LE(columns(dgettext(message.domain, message.id)), 14) << message.id;
  }
}

TEST_P(Catalogue, CallsTheWifiCheckBoxByItsName) {
  EXPECT_NE(text(kWifiMissing).find(text(kWifiOnlyCheck)), std::string::npos);
}

TEST_P(Catalogue, NamesTheSameButtonAlikeInBothDomains) {
  for (const char* id : {"IDS_TPLATFORM_ACBUTTON_CANCEL_ABB", "IDS_TPLATFORM_ACBUTTON_DONE_ABB"}) {
    EXPECT_STREQ(dgettext(kViewer, id), dgettext(kPlatform, id));
  }
}

TEST_P(Catalogue, HasTheSizeReadAfterTheNumberOfFiles) {
  auto summary = icu::UnicodeString::fromUTF8(text("IDS_RSH_SBODY_P1SD_FILES_HP2SS_P3SS_ABB"));
  summary.findAndReplace("%1$d", "15").findAndReplace("%2$s", "6.96").findAndReplace("%3$s", "MB");
  const std::string line = fromLeftToRight(summary);
  const size_t count = line.find("15"), size = line.find("6.96 MB");
  ASSERT_TRUE(count != std::string::npos && size != std::string::npos) << line;
  EXPECT_EQ(count > size, isReadFromTheRight()) << line;
}

/// What a screen reader says of a file; the English words are their own identifiers.
TEST_P(Catalogue, HasTheWordsOfTheScreenReader) {
  const bool english = strcmp(GetParam(), "en") == 0;
  for (const char* word : {"Back", "file", "missing", "on this phone", "requested", "downloading",
                           "downloaded", "not downloaded", "selected"}) {
    EXPECT_EQ(text(word) == word, english) << word;
  }
}

INSTANTIATE_TEST_SUITE_P(Languages, Catalogue, testing::ValuesIn(kLanguages),
                         [](const auto& info) { return info.param; });

// Guards the tests above: languages that fall back to each other would all pass.
TEST(Catalogues, DifferFromEachOther) {
  setlocale(LC_ALL, "C.UTF-8");
  bindtextdomain(kViewer, kDomains[0].folder);
  std::vector<std::string> seen;
  for (const char* language : kLanguages) {
    setenv("LANGUAGE", language, 1);
    ++_nl_msg_cat_cntr;
    const std::string text = dgettext(kViewer, kDownloadButton);
    for (const std::string& other : seen) EXPECT_NE(text, other) << language;
    seen.push_back(text);
  }
}

}  // namespace
