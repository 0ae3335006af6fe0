#ifndef VORL_VORL_H
#define VORL_VORL_H

/// @file
/// Everything public in one include. A program that cares for its build times includes the headers
/// that it uses.

#include <vorl/Common/BaseClass.h>
#include <vorl/Common/HRTimer.h>
#include <vorl/Common/ILogging.h>
#include <vorl/Common/LogContext.h>
#include <vorl/Common/LogManager.h>
#include <vorl/Common/OpBase.h>
#include <vorl/Common/dStatus.h>
#include <vorl/export.h>
#include <vorl/fwd.h>

#endif
