/// What recipients learn of a share.
#pragma once

#include <string>
#include <vector>

#include "BlobStore.h"
#include "Share.h"

namespace service {

/// JSON text; addresses are relative to the share's own, pictures stand in it when they are there.
std::string writeManifest(const Share& share, const std::vector<ShareFile>& files,
                          const BlobStore& blobs);

}  // namespace service
