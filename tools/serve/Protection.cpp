// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/serve/Protection.h"

#include "host/http/EventLog.h"
#include "host/http/Server.h"
#include "tools/serve/ServeOptions.h"

#include <exception>
#include <functional>
#include <string>

namespace Tools {

namespace {

using Host::Http::Certificate;
using Host::Http::Passwords;
using Host::Http::report;
using Host::Http::Severity;

std::shared_ptr<const Certificate> readCertificate(const ServeOptions& options)
{
    return options.certificate ? Certificate::read(*options.certificate, *options.key) : nullptr;
}

std::shared_ptr<const Passwords> readPasswords(const ServeOptions& options)
{
    return options.passwords
               ? std::make_shared<const Passwords>(Passwords::read(*options.passwords))
               : nullptr;
}

void attempt(const std::string& what, const std::function<void()>& renewal)
{
    try {
        renewal();
        report({"renew", "Protection", __LINE__}, "read " + what + " again", Severity::information);
    } catch (const std::exception& error) {
        report({"renew", "Protection", __LINE__},
            std::string(error.what()) + "; what was read before stays in force", Severity::error);
    }
}

} // namespace

Protection::Protection(const ServeOptions& options)
    : options_(options), certificate_(readCertificate(options)), passwords_(readPasswords(options))
{
}

void Protection::renew(Host::Http::Server& server) const
{
    if (options_.certificate)
        attempt("the certificate " + *options_.certificate,
            [&] { server.replaceCertificate(readCertificate(options_)); });
    if (options_.passwords)
        attempt("the passwords in " + *options_.passwords,
            [&] { server.replacePasswords(readPasswords(options_)); });
}

} // namespace Tools
