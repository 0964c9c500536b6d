// The thumbnail program: reads jobs of five texts, each ended by a zero byte, from its standard
// input and answers each with one character, until the input ends.
#include <sys/resource.h>

#include <array>
#include <cstdio>
#include <string>

#include "Picture.h"

namespace {

constexpr rlim_t kMemory = rlim_t{1536} << 20;
constexpr rlim_t kFileSize = rlim_t{64} << 20;
constexpr std::size_t kMaxField = 8192;

void limit(int resource, rlim_t value) {
  const rlimit bound{value, value};
  setrlimit(static_cast<__rlimit_resource_t>(resource), &bound);
}

void limitResources() {
#ifndef __SANITIZE_ADDRESS__  // which reserves terabytes of addresses
  limit(RLIMIT_AS, kMemory);
#endif
  limit(RLIMIT_FSIZE, kFileSize);
  limit(RLIMIT_CORE, 0);
}

bool readField(std::string& field) {
  field.clear();
  for (int c = getchar(); c != EOF && field.size() < kMaxField; c = getchar()) {
    if (c == '\0') return true;
    field += static_cast<char>(c);
  }
  return false;
}

bool makePictures(const std::array<std::string, 5>& job) {
  const auto& [kind, input, thumb, mid, big] = job;
  const thumbnailer::Picture picture =
      kind == "video" ? thumbnailer::loadVideoFrame(input) : thumbnailer::loadPicture(input);
  if (!picture) return false;
  thumbnailer::savePicture(picture.get(), thumbnailer::kBigPx, big);
  thumbnailer::savePicture(picture.get(), thumbnailer::kMidPx, mid);
  return thumbnailer::savePicture(picture.get(), thumbnailer::kThumbPx, thumb);
}

}  // namespace

int main() {
  limitResources();
  std::array<std::string, 5> job;
  while (readField(job[0]) && readField(job[1]) && readField(job[2]) && readField(job[3]) &&
         readField(job[4])) {
    putchar(makePictures(job) ? '1' : '0');
    fflush(stdout);
  }
  return 0;
}
