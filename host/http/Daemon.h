// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/http/ListeningSocket.h"
#include "host/http/ReportInterval.h"

#include <atomic>
#include <cstdarg>
#include <memory>

struct MHD_Daemon;

namespace Host::Http {

class Certificate;
struct Service;

// libmicrohttpd's daemon for one listening socket: a thread accepts connections, and each of them
// has a thread of its own.
class Daemon {
public:
    // Throws std::runtime_error when the library fails. The service must outlive it, and have a
    // certificate where the socket is encrypted.
    Daemon(Service& service, ListeningSocket socket);
    // Begins the shutdown of the service's connections, closes all of them and joins the threads of
    // this daemon.
    ~Daemon();
    Daemon(const Daemon&) = delete;
    Daemon& operator=(const Daemon&) = delete;

    // From now on no client can connect; connections that are open stay. Idempotent.
    void stopAccepting();

private:
    struct Stopping {
        void operator()(MHD_Daemon* daemon) const;
    };

    void start(const Certificate* certificate);
    // Logs a line of the library: each while it starts; then at most one a minute that contains
    // "Failed", and all others as details, since clients cause some of them.
    static void logLine(void* daemon, const char* format, std::va_list arguments) noexcept;

    Service& service_;
    ListeningSocket socket_;
    std::atomic<bool> isStarted_ = false;
    ReportInterval lines_;
    std::unique_ptr<MHD_Daemon, Stopping> daemon_;
    bool isAccepting_ = true;
};

} // namespace Host::Http
