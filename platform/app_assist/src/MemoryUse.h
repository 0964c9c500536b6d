/// How much of what it no longer uses an application keeps: little, for the phone's memory is for
/// all of them.
#pragma once

namespace app_assist {

/// For everything in the process; before the first thread.
void limitFreedMemory();
/// For the toolkit; after its start, before the first window.
void limitCaches();
/// After a request: the page before it leaves pieces all over the heap, more with every request.
void returnFreedMemorySoon();

}  // namespace app_assist
