/// The phone's settings, as the test says them.
#pragma once

#include <string>

void setServiceUrl(const std::string& url);
void setOwnNumber(const std::string& number);
