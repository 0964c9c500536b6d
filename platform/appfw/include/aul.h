/// Forwarding of a launch request.
#pragma once

#include <bundle.h>

#ifdef __cplusplus
extern "C" {
#endif

#define AUL_K_CALLER_PID "__AUL_CALLER_PID__"
#define AUL_K_CALLER_APPID "__AUL_CALLER_APPID__"
#define AUL_K_ORG_CALLER_PID "__AUL_ORG_CALLER_PID__"
#define AUL_K_WAIT_RESULT "__AUL_WAIT_RESULT__"

typedef enum _aul_return_val {
  AUL_R_EREJECTED = -14,
  AUL_R_ENOAPP = -13,
  AUL_R_EHIDDENFORGUEST = -11,
  AUL_R_ENOLAUNCHPAD = -10,
  AUL_R_ETERMINATING = -9,
  AUL_R_EILLACC = -8,
  AUL_R_LOCAL = -7,
  AUL_R_ETIMEOUT = -6,
  AUL_R_ECANCELED = -5,
  AUL_R_EINVAL = -4,
  AUL_R_ECOMM = -3,
  AUL_R_ENOINIT = -2,
  AUL_R_ERROR = -1,
  AUL_R_OK = 0
} aul_return_val;

/// Launches `appid` with a received request's bundle, which stays the caller's and gets
/// AUL_K_ORG_CALLER_PID set. Negative on failure; a bundle without AUL_K_CALLER_PID was not
/// received from anybody and is AUL_R_EINVAL.
int aul_forward_app(const char* appid, bundle* kb);

#ifdef __cplusplus
}
#endif
