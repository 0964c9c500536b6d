/// The phone's record of the launch requests that applications sent.
#pragma once

#include "Bundle.h"

namespace appfw {

/// Appends one JSON object to dbspace/launches.jsonl. Failures are ignored: the record is for
/// onlookers.
void recordLaunch(const bundle& request);

}  // namespace appfw
