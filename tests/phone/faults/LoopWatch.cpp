#include "LoopWatch.h"

#include <gtest/gtest.h>

#include "Phone.h"

namespace {

constexpr const char* kWatch = LOOP_WATCH;

}  // namespace

LoopWatch::LoopWatch() {
  const std::string state = phone::thePhone().folder();
  GError* error = nullptr;
  _process.reset(g_subprocess_new(
      static_cast<GSubprocessFlags>(G_SUBPROCESS_FLAGS_STDIN_PIPE | G_SUBPROCESS_FLAGS_STDOUT_PIPE),
      &error, PHONE_COMMAND, "--state", state.c_str(), "shell", kWatch, "zelqo-viewer", nullptr));
  EXPECT_TRUE(_process) << error->message;
  g_clear_error(&error);
  _answers.reset(g_data_input_stream_new(g_subprocess_get_stdout_pipe(_process.get())));
}

LoopWatch::~LoopWatch() {
  g_output_stream_close(g_subprocess_get_stdin_pipe(_process.get()), nullptr, nullptr);
  g_subprocess_wait(_process.get(), nullptr, nullptr);
}

void LoopWatch::begin() {
  EXPECT_EQ(ask("begin"), "begun");
}

std::string LoopWatch::settle(std::chrono::milliseconds patience) {
  return ask("settle " + std::to_string((phone::kSlowness * patience).count()));
}

std::string LoopWatch::rest(std::chrono::milliseconds patience) {
  return ask("rest " + std::to_string((phone::kSlowness * patience).count()));
}

void LoopWatch::run(const std::string& command) {
  EXPECT_EQ(ask("do " + command), "done");
}

void LoopWatch::tap(const std::string& place) {
  std::string words = place;
  words.replace(words.find(','), 1, " ");
  run("xdotool mousemove " + words + " mousedown 1 sleep 0.02 mouseup 1");  // "click" waits longer
}

void LoopWatch::key(const std::string& name) {
  run("xdotool key --delay 0 " + name);
}

std::chrono::milliseconds LoopWatch::longestWait() {
  const std::string report = ask("report");
  const size_t idle = report.find("idle ");
  EXPECT_NE(idle, std::string::npos) << report;
  return std::chrono::milliseconds(idle == std::string::npos ? 0
                                                             : std::stol(report.substr(idle + 5)));
}

std::string LoopWatch::ask(const std::string& order) {
  const std::string line = order + '\n';
  GOutputStream* input = g_subprocess_get_stdin_pipe(_process.get());
  g_output_stream_write_all(input, line.data(), line.size(), nullptr, nullptr, nullptr);
  g_output_stream_flush(input, nullptr, nullptr);
  char* answer = g_data_input_stream_read_line(_answers.get(), nullptr, nullptr, nullptr);
  std::string text = answer ? answer : "";
  g_free(answer);
  return text;
}
