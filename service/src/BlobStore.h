/// The service's files. What recipients read lies under share/TOKEN/ in exactly the layout of the
/// addresses, so that any web server can serve it; a share appears there, and goes, as a whole.
#pragma once

#include <cstdint>
#include <optional>
#include <string>

namespace service {

enum class BlobKind { File, Thumb, Mid, Big };

/// The word in the address: "file", "thumb", "mid", "big".
const char* blobWord(BlobKind kind);
std::optional<BlobKind> blobKind(const std::string& word);

class BlobStore {
 public:
  explicit BlobStore(std::string root);
  /// Makes the folders; false, with a log line, when that fails.
  bool open();

  /// The folder of uploads that have not ended.
  std::string incoming() const { return _root + "/incoming"; }
  std::string publishedManifest(const std::string& token) const;
  std::string published(const std::string& token, BlobKind kind, std::int64_t index) const;
  std::string staged(std::int64_t id, BlobKind kind, std::int64_t index) const;
  /// Whether a staged file of any kind is there, and how large.
  std::optional<std::int64_t> stagedSize(std::int64_t id, BlobKind kind, std::int64_t index) const;

  bool makeStaging(std::int64_t id) const;
  /// Moves the staged share to where recipients read it.
  bool publish(std::int64_t id, const std::string& token, const std::string& manifest) const;
  /// Nothing of the share is served from the moment of return; its bytes go in the background.
  void withdraw(std::int64_t id, const std::string& token) const;

 private:
  std::string shareFolder(const std::string& token) const;
  std::string stagingFolder(std::int64_t id) const;
  void emptyTrash() const;
  void discard(const std::string& folder) const;

  std::string _root;
};

}  // namespace service
