/* Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0 */

/* Threads, as the broker's operating-system services describe them (CMPIBrokerExtFT). */

#ifndef CMPIOS_H
#define CMPIOS_H

#include "cmpipl.h"

#include <time.h>

#ifdef __cplusplus
extern "C" {
#endif

#define CMPI_THREAD_CDECL
#define CMPI_THREAD_RETURN void*
#define CMPI_THREAD_TYPE void*
#define CMPI_MUTEX_TYPE void*
#define CMPI_COND_TYPE void*
#define CMPI_THREAD_KEY_TYPE unsigned int

typedef CMPI_THREAD_RETURN(CMPI_THREAD_CDECL* CMPIThreadFunc)(void* parameter);
typedef void (*CMPIThreadOnceFunc)(void);
typedef void (*CMPIThreadKeyCleanupFunc)(void* value);

#ifdef __cplusplus
}
#endif

#endif
