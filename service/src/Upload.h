/// One file on its way from a sender to the disk; never in memory as a whole.
#pragma once

#include <libsoup/soup.h>

#include <cstdint>
#include <string>

#include "Owned.h"

namespace service {

class Upload {
 public:
  enum class Result { Complete, TooLong, TooShort, DiskError };

  /// Takes over the body of a request whose headers have been read, into a new file of the folder
  /// `incoming`. `expected` is the announced size, or -1; at most `limit` bytes are taken.
  static void attach(SoupServerMessage* message, const std::string& incoming, std::int64_t expected,
                     std::int64_t limit);
  /// The upload of a request whose body has been read; null when none was attached.
  static Upload* of(SoupServerMessage* message);

  ~Upload();
  Upload(const Upload&) = delete;
  Upload& operator=(const Upload&) = delete;

  /// Puts a complete file under its final name, in place of an earlier one.
  Result finish(const std::string& path);

 private:
  Upload(const std::string& incoming, std::int64_t expected, std::int64_t limit);
  static void gotChunkCb(SoupServerMessage* message, GBytes* chunk, gpointer self);
  void write(GBytes* chunk);

  std::string _part;
  std::int64_t _expected;
  std::int64_t _limit;
  std::int64_t _written = 0;
  bool _tooLong = false;
  Fd _fd;
};

}  // namespace service
