#pragma once

/// Shows a message in the phone's status bar for a moment.
void zqvPostStatusMessage(const char* id);
