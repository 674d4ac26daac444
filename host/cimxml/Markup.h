// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Writes elements: always with a start tag and an end tag, since some clients do not support
// empty-element tags, with the five predefined entities and without CDATA.

#pragma once

#include "host/cimxml/Characters.h"

#include <string>
#include <string_view>

namespace Host::CimXml {

// Appends the start tag on construction and the end tag on destruction. Attributes come before any
// content. The text must outlive it.
class Markup {
public:
    // The name must outlive it too.
    Markup(std::string& out, std::string_view name) : out_(out), name_(name)
    {
        out_.append(1, '<').append(name_) += '>';
    }
    ~Markup() { out_.append("</", 2).append(name_) += '>'; }
    Markup(const Markup&) = delete;
    Markup& operator=(const Markup&) = delete;

    Markup& attribute(std::string_view name, std::string_view value)
    {
        out_.back() = ' ';
        out_.append(name).append("=\"", 2);
        appendEscaped(out_, value);
        out_.append("\">", 2);
        return *this;
    }

    Markup& content(std::string_view text)
    {
        appendEscaped(out_, text);
        return *this;
    }

private:
    std::string& out_;
    std::string_view name_;
};

} // namespace Host::CimXml
