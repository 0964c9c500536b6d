#pragma once

#include <notification_status.h>
