/// The application framework: one include for all of it.
#pragma once

#include "app_assist/WApp.h"
#include "app_assist/WContentViewController.h"
#include "app_assist/WGengridItem.h"
#include "app_assist/WGenlistItem.h"
#include "app_assist/WNaviframeController.h"
#include "app_assist/WPopupController.h"
#include "app_assist/WViewController.h"
#include "app_assist/WWindowController.h"
