/// The calls that talk to the sharing service, by the names under which they are found when the
/// first of them is needed.
#pragma once

#include "zelqo.h"

extern "C" {
int zelqo_transfer_download(const char** urls, unsigned int count, const char* folder, int priority,
                            int flags, zelqo_download_cb callback, void* user_data);
int zelqo_transfer_recall(unsigned int request_id, zelqo_recall_cb callback, void* user_data);
}
