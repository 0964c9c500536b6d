#include "LogLine.h"
#include "Repetition.h"
#include "TestPhone.h"

#include <dlog.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <climits>

using dlog::logLine;
using dlog::oneLine;
using dlog::Repetition;

namespace {

constexpr size_t kPlenty = 4096;

/// What a piece of code writes to stderr.
template <typename Code>
std::string stderrOf(Code code) {
  testing::internal::CaptureStderr();
  code();
  return testing::internal::GetCapturedStderr();
}

}  // namespace

TEST(LogLine, CarriesPriorityTagAndProcess) {
  EXPECT_EQ(logLine('E', "ZQ_VIEWER", 42, "text"), "E/ZQ_VIEWER(   42): text\n");
}

TEST(LogLine, KeepsColours) {
  EXPECT_EQ(oneLine("a.cpp: f(1) > \033[0;31m* Critical * no\033[0;m", kPlenty),
            "a.cpp: f(1) > \033[0;31m* Critical * no\033[0;m");
}

TEST(LogLine, KeepsTwoLineBreaksAsTextInOneLine) {
  EXPECT_EQ(oneLine("connection is failed\n\n", kPlenty), "connection is failed\\n\\n");
}

TEST(LogLine, CannotBeForgedByAText) {
  const struct {
    const char* text;
    const char* line;
  } cases[] = {
      {"a\nE/OTHER(    1): b", "a\\nE/OTHER(    1): b"},
      {"a\rb", "a\\rb"},
      {"a\033[2Jb", "a\\x1b[2Jb"},
      {"a\033]0;title\ab", "a\\x1b]0;title\\x07b"},
      {"a\033[0;31", "a\\x1b[0;31"},
      {"a\xc2\x85"
       "b",
       "a\\xc2\\x85b"},
      {"a\xe2\x80\xa8"
       "b",
       "a\\xe2\\x80\\xa8b"},
  };
  for (const auto& [text, line] : cases) EXPECT_EQ(oneLine(text, kPlenty), line);
}

TEST(LogLine, EscapesWhatIsNotUtf8AndKeepsWhatIs) {
  EXPECT_EQ(oneLine("caf\xc3\xa9 \xff\xe2\x82", kPlenty), "caf\xc3\xa9 \\xff\\xe2\\x82");
}

TEST(LogLine, IsCutBeforeItCouldMixWithAnothers) {
  const std::string line = logLine('I', "TAG", 1, std::string(100000, 'x'));
  EXPECT_LE(line.size(), static_cast<size_t>(PIPE_BUF));
  EXPECT_EQ(line.substr(line.size() - 9), "\033[0;m...\n");
}

TEST(LogLine, CutsALongTagAsWell) {
  EXPECT_LE(logLine('I', std::string(100000, 't'), 1, "x").size(), 100u);
}

TEST(Log, WritesOneLineToStderr) {
  std::string expected = logLine('E', "TAG", getpid(), "7 times");
  int written = 0;
  EXPECT_EQ(stderrOf([&] { written = dlog_print(DLOG_ERROR, "TAG", "%d %s", 7, "times"); }),
            expected);
  EXPECT_EQ(written, static_cast<int>(expected.size()));
}

TEST(Log, HasALetterForEveryPriority) {
  const struct {
    log_priority priority;
    char letter;
  } cases[] = {{DLOG_VERBOSE, 'V'}, {DLOG_DEBUG, 'D'}, {DLOG_INFO, 'I'},
               {DLOG_WARN, 'W'},    {DLOG_ERROR, 'E'}, {DLOG_FATAL, 'F'}};
  for (const auto& [priority, letter] : cases) {
    const std::string line = stderrOf([p = priority] { dlog_print(p, "T", "x"); });
    ASSERT_FALSE(line.empty());
    EXPECT_EQ(line[0], letter);
  }
}

TEST(Log, RefusesMissingTagFormatAndUnknownPriority) {
  const char* none = nullptr;
  va_list nothing{};
  EXPECT_EQ(stderrOf([&] {
              EXPECT_EQ(dlog_print(DLOG_ERROR, none, "x"), DLOG_ERROR_INVALID_PARAMETER);
              // NOLINTNEXTLINE(clang-diagnostic-format-nonliteral): there is no format at all
              EXPECT_EQ(dlog_vprint(DLOG_ERROR, "T", none, nothing), DLOG_ERROR_INVALID_PARAMETER);
              EXPECT_EQ(dlog_print(DLOG_UNKNOWN, "T", "x"), DLOG_ERROR_INVALID_PARAMETER);
              EXPECT_EQ(dlog_print(DLOG_PRIO_MAX, "T", "x"), DLOG_ERROR_INVALID_PARAMETER);
            }),
            "");
}

TEST(Log, IsSilentAtSilent) {
  EXPECT_EQ(stderrOf([] { EXPECT_EQ(dlog_print(DLOG_SILENT, "T", "x"), 0); }), "");
}

TEST(Log, LeavesErrnoAlone) {
  stderrOf([] {
    errno = ENOTDIR;
    dlog_print(DLOG_ERROR, "T", "x");
    EXPECT_EQ(errno, ENOTDIR);
  });
}

TEST(Log, CountsWhatIsSaidOverAndOverAndSaysSoBeforeAnythingElse) {
  const std::string text = stderrOf([] {
    for (int i = 0; i < 1000; i++) dlog_print(DLOG_ERROR, "T", "%s", "over and over");
    dlog_print(DLOG_INFO, "T", "something else");
  });
  const std::string same = logLine('E', "T", getpid(), "over and over");
  std::string expected;
  for (unsigned i = 0; i < Repetition::kWritten; i++) expected += same;
  expected += logLine('E', "T", getpid(),
                      "the line before, repeated: " + std::to_string(1000 - Repetition::kWritten));
  expected += logLine('I', "T", getpid(), "something else");
  EXPECT_EQ(text, expected);
}

TEST(Log, WritesEveryLineThatDiffersFromTheOneBefore) {
  const std::string text = stderrOf([] {
    for (int i = 0; i < 1000; i++) dlog_print(DLOG_ERROR, "T", "%d", i % 2);
  });
  EXPECT_EQ(std::count(text.begin(), text.end(), '\n'), 1000);
}

TEST(Log, SaysAtTheEndOfTheProcessHowOftenTheLastLineCame) {
  // A process of its own: one that is forked from here has lost its threads, and seems to leak them.
  GTEST_FLAG_SET(death_test_style, "threadsafe");
  EXPECT_EXIT(
      {
        for (int i = 0; i < 100; i++) dlog_print(DLOG_ERROR, "T", "x");
        exit(0);
      },
      testing::ExitedWithCode(0), "the line before, repeated: 84");
}

TEST(Repetition, IsNoneAfterASecond) {
  Repetition repetition;
  const Repetition::Line line{DLOG_ERROR, "T", "x"};
  for (unsigned i = 0; i < Repetition::kWritten; i++) {
    EXPECT_FALSE(repetition.isOneTooMany(line, 5));
    repetition.written(line, 5);
  }
  EXPECT_TRUE(repetition.isOneTooMany(line, Repetition::kWindowUs + 4));
  EXPECT_FALSE(repetition.isOneTooMany(line, Repetition::kWindowUs + 5));
  EXPECT_EQ(repetition.takeCount().message, "the line before, repeated: 1");
  EXPECT_EQ(repetition.takeCount().priority, DLOG_UNKNOWN);
}

TEST(Repetition, TellsPrioritiesTagsAndMessagesApart) {
  Repetition repetition;
  const Repetition::Line line{DLOG_ERROR, "T", "x"};
  for (unsigned i = 0; i < Repetition::kWritten; i++) repetition.written(line, 0);
  EXPECT_TRUE(repetition.isOneTooMany(line, 0));
  EXPECT_FALSE(repetition.isOneTooMany({DLOG_WARN, "T", "x"}, 0));
  EXPECT_FALSE(repetition.isOneTooMany({DLOG_ERROR, "U", "x"}, 0));
  EXPECT_FALSE(repetition.isOneTooMany({DLOG_ERROR, "T", "y"}, 0));
}
