#include "ThumbnailProcess.h"

#include <gio/gunixinputstream.h>
#include <poll.h>
#include <unistd.h>

#include <array>
#include <cerrno>

namespace service {
namespace {

constexpr int kAnswerTimeoutMs = 20000;
constexpr char kDone = '1';

}  // namespace

ThumbnailProcess::~ThumbnailProcess() {
  stop();
}

void ThumbnailProcess::stop() {
  if (_process) g_subprocess_force_exit(_process.get());
  _process.reset();
}

bool ThumbnailProcess::start() {
  if (_process) return true;
  ErrorOut error;
  const char* arguments[] = {_program.c_str(), nullptr};
  _process.reset(g_subprocess_newv(
      arguments,
      static_cast<GSubprocessFlags>(G_SUBPROCESS_FLAGS_STDIN_PIPE | G_SUBPROCESS_FLAGS_STDOUT_PIPE),
      error));
  if (!_process) g_warning("thumbnails: %s", error.message());
  return _process != nullptr;
}

bool ThumbnailProcess::run(const ThumbnailJob& job, GCancellable* cancellable) {
  return start() && send(job) && awaitAnswer(cancellable);
}

bool ThumbnailProcess::send(const ThumbnailJob& job) {
  std::string request(job.video ? "video" : "image");
  for (const std::string* field : {&job.input, &job.thumb, &job.mid, &job.big}) {
    request += '\0';
    request += *field;
  }
  request += '\0';
  if (g_output_stream_write_all(g_subprocess_get_stdin_pipe(_process.get()), request.data(),
                                request.size(), nullptr, nullptr, nullptr)) {
    return true;
  }
  stop();
  return false;
}

bool ThumbnailProcess::awaitAnswer(GCancellable* cancellable) {
  auto* output = G_UNIX_INPUT_STREAM(g_subprocess_get_stdout_pipe(_process.get()));
  std::array<pollfd, 2> watched = {{{g_unix_input_stream_get_fd(output), POLLIN, 0},
                                    {g_cancellable_get_fd(cancellable), POLLIN, 0}}};
  int ready = 0;
  do {
    ready = poll(watched.data(), watched.size(), kAnswerTimeoutMs);
  } while (ready < 0 && errno == EINTR);
  g_cancellable_release_fd(cancellable);
  char answer = 0;
  if (watched[0].revents && read(watched[0].fd, &answer, 1) == 1) return answer == kDone;
  if (!g_cancellable_is_cancelled(cancellable)) {
    g_warning("thumbnails: a file was given up, the program %s",
              ready == 0 ? "did not answer" : "ended");
  }
  stop();
  return false;
}

}  // namespace service
