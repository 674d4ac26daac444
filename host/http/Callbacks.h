// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What the HTTP library calls.

#pragma once

#include <microhttpd.h>

#include <cstdarg>
#include <cstddef>

namespace Host::Http::Callbacks {

// The closure of each is the Daemon. No exception passes.

void connectionChanged(void* daemon, MHD_Connection* connection, void** client,
    MHD_ConnectionNotificationCode what) noexcept;
void* requestBegins(void* daemon, const char* uri, MHD_Connection* connection) noexcept;
MHD_Result requestGoesOn(void* daemon, MHD_Connection* connection, const char* url,
    const char* method, const char* version, const char* piece, std::size_t* size,
    void** ignored) noexcept;
void requestEnded(void* daemon, MHD_Connection* connection, void** ignored,
    MHD_RequestTerminationCode how) noexcept;
void logLine(void* daemon, const char* format, std::va_list arguments) noexcept;

} // namespace Host::Http::Callbacks
