// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Elements as they are written: always with a start tag and an end tag, since some clients do
// not know empty-element tags, with the five named entities and without CDATA.

#pragma once

#include "host/cimxml/Characters.h"

#include <string>
#include <string_view>

namespace Host::CimXml {

// The start tag is written on construction, the end tag on destruction. Attributes come before
// any content. The text written to must outlive it.
class Markup {
public:
    // The name must outlive it too.
    Markup(std::string& out, std::string_view name) : out_(out), name_(name)
    {
        out_ += '<';
        out_ += name_;
        out_ += '>';
    }
    ~Markup()
    {
        out_ += '<';
        out_ += '/';
        out_ += name_;
        out_ += '>';
    }
    Markup(const Markup&) = delete;
    Markup& operator=(const Markup&) = delete;

    Markup& attribute(std::string_view name, std::string_view value)
    {
        out_.back() = ' ';
        out_ += name;
        out_ += '=';
        out_ += '"';
        appendEscaped(out_, value);
        out_ += '"';
        out_ += '>';
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
