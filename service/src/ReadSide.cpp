#include "ReadSide.h"

#include <fcntl.h>
#include <sys/stat.h>

#include <cinttypes>

#include "Address.h"
#include "ByteRange.h"
#include "HttpAnswer.h"

namespace service {
namespace {

constexpr char kPicture[] = "image/jpeg";
constexpr char kManifest[] = "application/json";
constexpr char kAnyFile[] = "application/octet-stream";

// An open file with what identifies its content; the tag is made as nginx makes it, so that a
// download begun at one read side can be resumed at the other.
class Content {
 public:
  explicit Content(const std::string& path)
      : _fd(::open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NOFOLLOW)) {
    if (_fd.valid() && (fstat(_fd.get(), &_status) != 0 || !S_ISREG(_status.st_mode))) _fd.close();
  }

  bool there() const { return _fd.valid(); }
  std::int64_t size() const { return _status.st_size; }

  std::string tag() const {
    char text[48];
    g_snprintf(text, sizeof text, "\"%" PRIx64 "-%" PRIx64 "\"",
               static_cast<std::uint64_t>(_status.st_mtime),
               static_cast<std::uint64_t>(_status.st_size));
    return text;
  }

  std::string modified() const {
    const Owned<GDateTime, g_date_time_unref> time(g_date_time_new_from_unix_utc(_status.st_mtime));
    const Text text(soup_date_time_to_string(time.get(), SOUP_DATE_HTTP));
    return text.get();
  }

  Bytes bytes() const {
    const MappedFile mapped(g_mapped_file_new_from_fd(_fd.get(), FALSE, nullptr));
    return Bytes(mapped ? g_mapped_file_get_bytes(mapped.get()) : nullptr);
  }

 private:
  Fd _fd;
  struct stat _status {};
};

bool matches(const char* condition, const Content& content) {
  return content.tag() == condition || content.modified() == condition;
}

void answerPart(SoupServerMessage* message, GBytes* bytes, const ByteRange& range) {
  const Bytes part(g_bytes_new_from_bytes(bytes, static_cast<gsize>(range.first),
                                          static_cast<gsize>(range.length)));
  soup_message_headers_set_content_range(soup_server_message_get_response_headers(message),
                                         range.first, range.first + range.length - 1,
                                         static_cast<goffset>(g_bytes_get_size(bytes)));
  soup_message_body_append_bytes(soup_server_message_get_response_body(message), part.get());
  soup_server_message_set_status(message, SOUP_STATUS_PARTIAL_CONTENT, nullptr);
}

void answerUnsatisfiable(SoupServerMessage* message, std::int64_t size) {
  answerError(message, SOUP_STATUS_REQUESTED_RANGE_NOT_SATISFIABLE, "no such range");
  const std::string whole = "bytes */" + std::to_string(size);
  soup_message_headers_replace(soup_server_message_get_response_headers(message), "Content-Range",
                               whole.c_str());
}

// Conditions are settled here: the library would copy the whole file for a range, and knows no
// If-Range.
void answerContent(SoupServerMessage* message, const Content& content) {
  SoupMessageHeaders* request = soup_server_message_get_request_headers(message);
  const char* known = soup_message_headers_get_list(request, "If-None-Match");
  if (known && matches(known, content)) {
    soup_server_message_set_status(message, SOUP_STATUS_NOT_MODIFIED, nullptr);
    return;
  }
  const char* unchanged = soup_message_headers_get_one(request, "If-Range");
  ByteRange range;
  if (!unchanged || matches(unchanged, content)) {
    range = parseByteRange(soup_message_headers_get_one(request, "Range"), content.size());
  }
  soup_message_headers_remove(request, "Range");
  if (range.kind == ByteRange::Kind::Unsatisfiable) {
    answerUnsatisfiable(message, content.size());
    return;
  }
  const Bytes bytes = content.bytes();
  if (!bytes) {
    answerError(message, SOUP_STATUS_INTERNAL_SERVER_ERROR, "cannot be read");
  } else if (range.kind == ByteRange::Kind::Part) {
    answerPart(message, bytes.get(), range);
  } else {
    if (content.size() > 0) {
      soup_message_body_append_bytes(soup_server_message_get_response_body(message), bytes.get());
    }
    soup_server_message_set_status(message, SOUP_STATUS_OK, nullptr);
  }
}

void answerFile(SoupServerMessage* message, const std::string& path, const char* type) {
  const Content content(path);
  if (!content.there()) {
    answerError(message, SOUP_STATUS_NOT_FOUND, "no such file");
    return;
  }
  SoupMessageHeaders* headers = soup_server_message_get_response_headers(message);
  soup_message_headers_replace(headers, "Content-Type", type);
  soup_message_headers_replace(headers, "ETag", content.tag().c_str());
  soup_message_headers_replace(headers, "Last-Modified", content.modified().c_str());
  soup_message_headers_replace(headers, "Accept-Ranges", "bytes");
  soup_message_headers_replace(headers, "Cache-Control", "private, no-cache");
  soup_message_headers_replace(headers, "X-Content-Type-Options", "nosniff");
  answerContent(message, content);
}

}  // namespace

void ReadSide::answer(SoupServerMessage* message, const std::vector<std::string>& path) {
  const std::string method = soup_server_message_get_method(message);
  if (method != "GET" && method != "HEAD") {
    soup_message_headers_replace(soup_server_message_get_response_headers(message), "Allow",
                                 "GET, HEAD");
    answerError(message, SOUP_STATUS_METHOD_NOT_ALLOWED, "read only");
    return;
  }
  const auto share = path.size() > 2 ? _catalog.shareByToken(path[1]) : std::nullopt;
  if (!share || share->state == ShareState::Draft || share->state == ShareState::Preparing) {
    answerError(message, SOUP_STATUS_NOT_FOUND, "no such share");
  } else if (share->closed() || share->expiresMs <= nowMs()) {
    answerError(message, SOUP_STATUS_GONE, "recalled or expired");
  } else if (path.size() == 3 && path[2] == "manifest.json") {
    _stats.manifests++;
    answerFile(message, _blobs.publishedManifest(share->token), kManifest);
  } else {
    const auto kind = path.size() == 4 ? blobKind(path[2]) : std::nullopt;
    const auto index = path.size() == 4 ? plainNumber(path[3]) : std::nullopt;
    if (kind && index) {
      answerBlob(message, share->token, *kind, *index);
    } else {
      answerError(message, SOUP_STATUS_NOT_FOUND, "no such file");
    }
  }
}

void ReadSide::answerBlob(SoupServerMessage* message, const std::string& token, BlobKind kind,
                          std::int64_t index) {
  _stats.blobs.at(static_cast<std::size_t>(kind))++;
  if (kind == BlobKind::File) {
    g_signal_connect(message, "wrote-body-data", G_CALLBACK(wroteFileBytesCb), &_stats);
  }
  answerFile(message, _blobs.published(token, kind, index),
             kind == BlobKind::File ? kAnyFile : kPicture);
}

void ReadSide::wroteFileBytesCb(SoupServerMessage*, guint size, gpointer stats) {
  static_cast<Stats*>(stats)->fileBytes += size;
}

}  // namespace service
