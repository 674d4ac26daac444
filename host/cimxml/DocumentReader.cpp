// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Names.h"
#include "host/cimxml/Element.h"

#include <expat.h>

#include <algorithm>
#include <array>
#include <exception>
#include <limits>
#include <memory>
#include <new>

namespace Host::CimXml {

namespace {

// The elements of DSP0201, sorted.
constexpr std::array<std::string_view, 68> knownNames = {"CIM", "CLASS", "CLASSNAME", "CLASSPATH",
    "CORRELATOR", "DECLARATION", "DECLGROUP", "DECLGROUP.WITHNAME", "DECLGROUP.WITHPATH",
    "ENUMERATIONCONTEXT", "ERROR", "EXPMETHODCALL", "EXPMETHODRESPONSE", "EXPPARAMVALUE", "HOST",
    "IMETHODCALL", "IMETHODRESPONSE", "INSTANCE", "INSTANCENAME", "INSTANCEPATH", "IPARAMVALUE",
    "IRETURNVALUE", "KEYBINDING", "KEYVALUE", "LOCALCLASSPATH", "LOCALINSTANCEPATH",
    "LOCALNAMESPACEPATH", "MESSAGE", "METHOD", "METHODCALL", "METHODRESPONSE", "MULTIEXPREQ",
    "MULTIEXPRSP", "MULTIREQ", "MULTIRSP", "NAMESPACE", "NAMESPACEPATH", "OBJECTPATH", "PARAMETER",
    "PARAMETER.ARRAY", "PARAMETER.REFARRAY", "PARAMETER.REFERENCE", "PARAMVALUE", "PROPERTY",
    "PROPERTY.ARRAY", "PROPERTY.REFERENCE", "QUALIFIER", "QUALIFIER.DECLARATION",
    "RESPONSEDESTINATION", "RETURNVALUE", "SCOPE", "SIMPLEEXPREQ", "SIMPLEEXPRSP", "SIMPLEREQ",
    "SIMPLEREQACK", "SIMPLERSP", "VALUE", "VALUE.ARRAY", "VALUE.INSTANCEWITHPATH",
    "VALUE.NAMEDINSTANCE", "VALUE.NAMEDOBJECT", "VALUE.NULL", "VALUE.OBJECT",
    "VALUE.OBJECTWITHLOCALPATH", "VALUE.OBJECTWITHPATH", "VALUE.REFARRAY", "VALUE.REFERENCE",
    "VALUE.REFERENCEARRAY"};
static_assert(std::is_sorted(knownNames.begin(), knownNames.end()));

bool isKnown(std::string_view name)
{
    return std::binary_search(knownNames.begin(), knownNames.end(), name);
}

struct FreeParser {
    void operator()(XML_Parser parser) const { XML_ParserFree(parser); }
};

} // namespace

// Builds the elements of one text from Expat's callbacks. No exception passes through Expat, which
// is written in C: it is stored and rethrown when the parser has returned.
class DocumentReader {
public:
    explicit DocumentReader(std::size_t maximumDepth)
        : parser_(XML_ParserCreate("UTF-8")), maximumDepth_(maximumDepth)
    {
        if (parser_ == nullptr)
            throw std::bad_alloc();
        XML_SetUserData(parser_.get(), this);
        XML_SetXmlDeclHandler(parser_.get(), declaration);
        XML_SetStartDoctypeDeclHandler(parser_.get(), documentType);
        XML_SetElementHandler(parser_.get(), startTag, endTag);
        XML_SetCharacterDataHandler(parser_.get(), characters);
    }

    Element read(std::string_view text)
    {
        // Expat reads UTF-16, which it recognises by these bytes, whatever encoding was set.
        if (text.starts_with('\xFE') || text.starts_with('\xFF') ||
            text.substr(0, 2).find('\0') != std::string_view::npos)
            fail("only the encoding UTF-8 is read");
        if (text.size() > std::numeric_limits<int>::max())
            fail("more than two gigabytes", Outcome::requestNotValid);
        const XML_Status status =
            XML_Parse(parser_.get(), text.data(), static_cast<int>(text.size()), XML_TRUE);
        if (failure_)
            std::rethrow_exception(failure_);
        const XML_Error error = XML_GetErrorCode(parser_.get());
        if (error == XML_ERROR_NO_MEMORY)
            throw std::bad_alloc();
        if (status != XML_STATUS_OK)
            fail(XML_ErrorString(error));
        return std::move(*root_);
    }

private:
    template <typename Callback>
    static void guarded(void* self, const Callback& callback)
    {
        auto& reader = *static_cast<DocumentReader*>(self);
        if (reader.failure_)
            return; // a stopped parser still finishes the current tag
        try {
            callback(reader);
        } catch (...) {
            reader.failure_ = std::current_exception();
            XML_StopParser(reader.parser_.get(), XML_FALSE);
        }
    }

    static void declaration(void* self, const char* version, const char* encoding, int)
    {
        guarded(self, [=](DocumentReader& reader) {
            if (version != nullptr && std::string_view(version) != "1.0")
                reader.fail("only version 1.0 of XML is read");
            if (encoding != nullptr && !equalNames(encoding, "utf-8") &&
                !equalNames(encoding, "us-ascii"))
                reader.fail("only the encoding UTF-8 is read");
        });
    }

    static void documentType(void* self, const char*, const char*, const char*, int)
    {
        guarded(self, [](DocumentReader& reader) {
            reader.fail("a document type is not accepted", Outcome::requestNotValid);
        });
    }

    static void startTag(void* self, const char* name, const char** attributes)
    {
        guarded(self, [=](DocumentReader& reader) { reader.open(name, attributes); });
    }

    static void endTag(void* self, const char*)
    {
        guarded(self, [](DocumentReader& reader) { reader.close(); });
    }

    static void characters(void* self, const char* text, int size)
    {
        guarded(self, [=](DocumentReader& reader) {
            if (reader.unknownDepth_ == 0)
                reader.open_.back()->text_.append(text, static_cast<std::size_t>(size));
        });
    }

    void open(const char* name, const char** attributes)
    {
        if (++elements_ > maximumElements)
            fail("more than " + std::to_string(maximumElements) + " elements",
                Outcome::requestNotValid);
        if (open_.size() + unknownDepth_ == maximumDepth_)
            fail("elements more than " + std::to_string(maximumDepth_) + " deep in one another",
                Outcome::requestNotValid);
        std::size_t attributeCount = 0;
        while (attributes[2 * attributeCount] != nullptr)
            if (++attributeCount > maximumAttributes)
                fail("more than " + std::to_string(maximumAttributes) + " attributes",
                    Outcome::requestNotValid);
        // The outermost element is kept whatever its name.
        if (unknownDepth_ != 0 || (root_ && !isKnown(name))) {
            ++unknownDepth_;
            return;
        }
        Element::Position place = position();
        ++place.offset; // the offset of the name
        Element& opened =
            root_ ? open_.back()->children_.emplace_back(name, place) : root_.emplace(name, place);
        for (std::size_t at = 0; at < attributeCount; ++at)
            opened.attributes_.emplace_back(attributes[2 * at], attributes[2 * at + 1]);
        open_.push_back(&opened); // only the last child of an element is open: none moves
    }

    void close()
    {
        if (unknownDepth_ != 0)
            --unknownDepth_;
        else
            open_.pop_back();
    }

    // Returns the position of the current event.
    Element::Position position() const
    {
        return {XML_GetCurrentLineNumber(parser_.get()),
            static_cast<std::size_t>(
                std::max(XML_GetCurrentByteIndex(parser_.get()), XML_Index{0}))};
    }

    [[noreturn]] void fail(
        const std::string& why, Outcome outcome = Outcome::requestNotWellFormed) const
    {
        throw RequestError(outcome, position().line, position().offset, why);
    }

    std::unique_ptr<XML_ParserStruct, FreeParser> parser_;
    std::size_t maximumDepth_;
    std::optional<Element> root_;
    std::vector<Element*> open_;   // from the outermost to the innermost
    std::size_t unknownDepth_ = 0; // the depth within an unknown element
    std::size_t elements_ = 0;
    std::exception_ptr failure_;
};

Element readDocument(std::string_view text, std::size_t maximumDepth)
{
    return DocumentReader(maximumDepth).read(text);
}

} // namespace Host::CimXml
