// Logging through ACE_Log_Msg. QUORVEX_LOG records the source file, line and the last system
// error with conditional_set before logging, so every message carries its origin. The format is
// ACE's printf-like format (%s, %d, %m, ...). Thread-safe (ACE_Log_Msg is per thread).
#pragma once

#include <ace/Log_Msg.h>
#include <ace/Log_Priority.h>

#include <cerrno>

#define QUORVEX_LOG(priority, ...)                                         \
    do {                                                                   \
        const int quorvexErrno = errno;                                    \
        ACE_Log_Msg* quorvexLog = ACE_Log_Msg::instance();                 \
        quorvexLog->conditional_set(__FILE__, __LINE__, -1, quorvexErrno); \
        quorvexLog->log(priority, __VA_ARGS__);                            \
    } while (0)
