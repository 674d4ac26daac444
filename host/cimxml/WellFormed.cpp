// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/cimxml/WellFormed.h"

#include "host/broker/Names.h"
#include "host/cimxml/Characters.h"
#include "host/cimxml/RequestError.h"
#include "host/repository/MofError.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <string>
#include <vector>

namespace Host::CimXml {

namespace {

constexpr bool beginsName(char c)
{
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || c == '_' || c == ':' ||
           static_cast<unsigned char>(c) >= 0x80;
}

constexpr bool continuesName(char c)
{
    return beginsName(c) || (c >= '0' && c <= '9') || c == '-' || c == '.';
}

class Scanner {
public:
    Scanner(std::string_view text, std::size_t maximumDepth)
        : text_(text), maximumDepth_(maximumDepth)
    {
    }

    void run()
    {
        if (startsWith("<?xml") && at_ + 5 < text_.size() && isWhiteSpace(text_[at_ + 5]))
            declaration();
        while (at_ < text_.size())
            text_[at_] == '<' ? markup() : characters();
        if (!open_.empty())
            fail("element " + quotation(open_.back()) + " has no end tag");
        if (elements_ == 0)
            fail("there is no element");
    }

private:
    [[noreturn]] void fail(
        const std::string& why, Outcome outcome = Outcome::requestNotWellFormed) const
    {
        throw RequestError(outcome, text_, at_, why);
    }

    bool startsWith(std::string_view what) const { return text_.substr(at_).starts_with(what); }
    bool isInElement() const { return !open_.empty(); }

    char current() const
    {
        if (at_ >= text_.size())
            fail("the text ends within markup");
        return text_[at_];
    }

    void expect(std::string_view what)
    {
        if (!startsWith(what))
            fail("expected " + std::string(what));
        at_ += what.size();
    }

    bool skipWhiteSpace()
    {
        const std::size_t before = at_;
        while (at_ < text_.size() && isWhiteSpace(text_[at_]))
            ++at_;
        return at_ != before;
    }

    void character()
    {
        const Character found = firstCharacter(text_.substr(at_));
        if (!found.isValid)
            fail("a byte that is no UTF-8");
        if (!isXmlCharacter(found.code))
            fail("a character that XML cannot hold");
        at_ += found.size;
    }

    // Steps over the end mark too.
    void skipTo(std::string_view end, const char* what)
    {
        while (!startsWith(end)) {
            if (at_ >= text_.size())
                fail(std::string(what) + " does not end");
            character();
        }
        at_ += end.size();
    }

    std::string_view name()
    {
        const std::size_t begin = at_;
        if (!beginsName(current()))
            fail("expected a name");
        while (continuesName(current()))
            character();
        return text_.substr(begin, at_ - begin);
    }

    void reference()
    {
        const std::size_t end = text_.find(';', at_);
        if (end == std::string_view::npos || end - at_ > 16)
            fail("an ampersand without an entity's name");
        const std::string_view body = text_.substr(at_ + 1, end - at_ - 1);
        static constexpr std::array<std::string_view, 5> predefined = {
            "amp", "lt", "gt", "quot", "apos"};
        if (body.starts_with("#")
                ? !isCharacterNumber(body.substr(1))
                : std::find(predefined.begin(), predefined.end(), body) == predefined.end())
            fail("no such entity or character");
        at_ = end + 1;
    }

    static bool isCharacterNumber(std::string_view digits)
    {
        const bool isHexadecimal = digits.starts_with("x");
        if (isHexadecimal)
            digits.remove_prefix(1);
        std::uint32_t code = 0;
        const char* const end = digits.data() + digits.size();
        const auto result = std::from_chars(digits.data(), end, code, isHexadecimal ? 16 : 10);
        return result.ec == std::errc() && result.ptr == end && isXmlCharacter(code);
    }

    void characters()
    {
        while (at_ < text_.size() && text_[at_] != '<') {
            if (!isInElement() && !isWhiteSpace(text_[at_]))
                fail("text outside the outermost element");
            if (startsWith("]]>"))
                fail("]]> in text");
            text_[at_] == '&' ? reference() : character();
        }
    }

    void markup()
    {
        if (startsWith("<!--"))
            comment();
        else if (startsWith("<![CDATA["))
            characterData();
        else if (startsWith("<!"))
            fail("a document type is not accepted", Outcome::requestNotValid);
        else if (startsWith("<?"))
            instruction();
        else if (startsWith("</"))
            endTag();
        else
            startTag();
    }

    void comment()
    {
        at_ += 4;
        skipTo("--", "a comment");
        expect(">");
    }

    void characterData()
    {
        if (!isInElement())
            fail("text outside the outermost element");
        at_ += 9;
        skipTo("]]>", "a CDATA section");
    }

    void instruction()
    {
        at_ += 2;
        if (equalNames(name(), "xml"))
            fail("an XML declaration that is not at the beginning");
        if (!skipWhiteSpace() && !startsWith("?>"))
            fail("expected white space after the name");
        skipTo("?>", "a processing instruction");
    }

    void declaration()
    {
        at_ += 5;
        std::string_view expected = "version";
        while (skipWhiteSpace() && !startsWith("?>")) {
            const auto [name, value] = attribute();
            if (!expected.empty() && name != expected)
                fail("an XML declaration begins with the version");
            expected = {};
            if (name == "version" && value != "1.0")
                fail("only version 1.0 of XML is read");
            if (name == "encoding" && !equalNames(value, "utf-8") && !equalNames(value, "us-ascii"))
                fail("only the encoding UTF-8 is read");
        }
        if (!expected.empty())
            fail("an XML declaration without version");
        expect("?>");
    }

    std::pair<std::string_view, std::string_view> attribute()
    {
        const std::string_view attributeName = name();
        skipWhiteSpace();
        expect("=");
        skipWhiteSpace();
        const char quote = current();
        if (quote != '"' && quote != '\'')
            fail("expected a quotation mark");
        const std::size_t begin = ++at_;
        while (current() != quote) {
            if (text_[at_] == '<')
                fail("< in an attribute");
            text_[at_] == '&' ? reference() : character();
        }
        const std::string_view value = text_.substr(begin, at_ - begin);
        ++at_;
        return {attributeName, value};
    }

    void startTag()
    {
        if (!isInElement() && elements_ != 0)
            fail("a second outermost element");
        if (++elements_ > maximumElements)
            fail("more than " + std::to_string(maximumElements) + " elements",
                Outcome::requestNotValid);
        if (open_.size() == maximumDepth_)
            fail("elements more than " + std::to_string(maximumDepth_) + " deep in one another",
                Outcome::requestNotValid);
        ++at_;
        open_.push_back(name());
        attributes();
        if (current() == '/') {
            ++at_;
            open_.pop_back();
        }
        expect(">");
    }

    void attributes()
    {
        std::array<std::string_view, maximumAttributes> names;
        std::size_t count = 0;
        while (skipWhiteSpace() && current() != '>' && current() != '/') {
            const std::string_view found = attribute().first;
            const auto* const end = names.begin() + count;
            if (std::find(names.cbegin(), end, found) != end)
                fail("attribute " + quotation(found) + " comes twice");
            if (count == maximumAttributes)
                fail("more than " + std::to_string(maximumAttributes) + " attributes",
                    Outcome::requestNotValid);
            names[count++] = found;
        }
    }

    void endTag()
    {
        at_ += 2;
        const std::string_view found = name();
        if (open_.empty() || open_.back() != found)
            fail("end tag " + quotation(found) + " where " +
                 (open_.empty() ? "nothing is open" : quotation(open_.back()) + " is open"));
        open_.pop_back();
        skipWhiteSpace();
        expect(">");
    }

    std::string_view text_;
    std::size_t maximumDepth_;
    std::size_t at_ = 0;
    std::size_t elements_ = 0;
    std::vector<std::string_view> open_;
};

} // namespace

void requireWellFormed(std::string_view text, std::size_t maximumDepth)
{
    Scanner(text, maximumDepth).run();
}

} // namespace Host::CimXml
