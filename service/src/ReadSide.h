/// What recipients fetch: manifests, files and pictures of published shares.
#pragma once

#include <libsoup/soup.h>

#include <string>
#include <vector>

#include "BlobStore.h"
#include "Catalog.h"
#include "Stats.h"

namespace service {

class ReadSide {
 public:
  ReadSide(Catalog& catalog, const BlobStore& blobs, Stats& stats)
      : _catalog(catalog), _blobs(blobs), _stats(stats) {}

  /// Answers GET and HEAD of share/TOKEN/manifest.json and share/TOKEN/KIND/N.
  void answer(SoupServerMessage* message, const std::vector<std::string>& path);

 private:
  void answerBlob(SoupServerMessage* message, const std::string& token, BlobKind kind,
                  std::int64_t index);
  static void wroteFileBytesCb(SoupServerMessage* message, guint size, gpointer stats);

  Catalog& _catalog;
  const BlobStore& _blobs;
  Stats& _stats;
};

}  // namespace service
