// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/cimxml/InstanceElement.h"

#include "host/broker/Array.h"
#include "host/broker/Names.h"
#include "host/broker/String.h"
#include "host/broker/Types.h"
#include "host/cimxml/Literal.h"
#include "host/cimxml/Markup.h"
#include "host/cimxml/PathElement.h"
#include "host/cimxml/QualifierElement.h"

#include <algorithm>

namespace Host::CimXml {

namespace {

// Appends the content of VALUE.
void writeContent(std::string& out, const Value& value)
{
    if (value.type() == CMPI_instance) {
        std::string text;
        InstanceMarkup().write(text, *value.instance(), nullptr);
        appendEscaped(out, text);
    } else {
        appendLiteral(out, value);
    }
}

// Returns whether the value is written as one VALUE, not as nothing, an array or a reference.
bool isSingle(const Value& value)
{
    return !value.isNull() && !isArrayType(value.type()) && value.type() != CMPI_ref;
}

// Appends VALUE for each element that is not null, with the markup between two in one piece.
void writeElements(std::string& out, const Array& array)
{
    constexpr std::string_view first = "<VALUE>";
    std::string_view before = first;
    for (const Value& each : array.elements())
        if (!each.isNull()) {
            out += before;
            writeContent(out, each);
            before = "</VALUE><VALUE>";
        }
    if (before != first)
        out += "</VALUE>";
}

// Appends the property's element with an empty VALUE where its value is a single one, else without
// a value. Returns the offset at which the value is to be inserted.
std::size_t writeFrame(std::string& out, std::string_view name, CMPIType valueType, bool hasSingle,
    const ClassDeclaration* declared, const ObjectSelection& selection)
{
    const PropertyDeclaration* const property =
        declared == nullptr ? nullptr : declared->property(name);
    const bool isTypeless = valueType == CMPI_null && property != nullptr;
    const CMPIType type = isTypeless ? property->type : valueType;
    Markup element(out, elementNameFor(type));
    element.attribute("NAME", name);
    if (type != CMPI_ref)
        element.attribute("TYPE", nameOf(type));
    else if (property != nullptr && !property->referenceClass.empty())
        element.attribute("REFERENCECLASS", property->referenceClass);
    if (selection.includeClassOrigin && property != nullptr) {
        element.attribute("CLASSORIGIN", property->origin->name);
        if (property->declaredIn != declared)
            element.attribute("PROPAGATED", "true");
    }
    if (elementType(type) == CMPI_instance)
        element.attribute("EmbeddedObject", "instance");
    else if (property != nullptr)
        writeEmbeddedObject(element, property->qualifiers);
    if (property != nullptr)
        writeQualifiers(out, property->qualifiers, selection);
    if (!hasSingle)
        return out.size();
    const Markup single(out, "VALUE");
    return out.size();
}

} // namespace

void writeValue(std::string& out, const Value& value)
{
    if (isSingle(value)) {
        // Most elements of an answer are written here. Markup would measure the name each time.
        out += std::string_view("<VALUE>");
        writeContent(out, value);
        out += std::string_view("</VALUE>");
    } else if (const Array* const array = value.array()) {
        const Markup element(out, array->type() == CMPI_ref ? "VALUE.REFARRAY" : "VALUE.ARRAY");
        if (array->type() == CMPI_ref)
            for (const Value& each : array->elements())
                writeValue(out, each);
        else
            writeElements(out, *array);
    } else if (const ObjectPath* const reference = value.path()) {
        writeReference(out, *reference);
    }
}

void InstanceMarkup::write(
    std::string& out, const Instance& instance, const ClassDeclaration* declared)
{
    if (declared != declared_)
        useClass(declared);
    next_ = 0;
    isWritten_.assign(listed_.size(), false);
    Markup element(out, "INSTANCE");
    element.attribute("CLASSNAME", instance.className());
    if (declared != nullptr)
        writeQualifiers(out, declared->qualifiers, selection_);
    // The end of a frame is written together with the beginning of the next one.
    std::size_t written = 0;
    std::size_t end = 0;
    const auto writeUntil = [&](const Frame& frame, std::size_t place) {
        if (frame.begin != end) {
            out.append(markup_, written, end - written);
            written = frame.begin;
        }
        out.append(markup_, written, place - written);
        written = place;
        end = frame.end;
    };
    for (const auto& [name, value] : instance.properties()) {
        Frame& frame = frameFor(*name->text(), value);
        if (frame.begin == frame.end)
            continue;
        writeUntil(frame, frame.valueAt);
        if (frame.isSingle)
            writeContent(out, value);
        else if (const Array* const array = value.array())
            writeArray(out, *array, frame);
        else
            writeValue(out, value);
        if (frame.listedAt < listed_.size())
            isWritten_[frame.listedAt] = true;
    }
    for (std::size_t i = 0; i < listed_.size(); ++i)
        if (!isWritten_[i]) {
            const Frame& frame = frameFor(listed_[i], Value());
            writeUntil(frame, frame.end);
        }
    out.append(markup_, written, end - written);
}

void InstanceMarkup::useClass(const ClassDeclaration* declared)
{
    declared_ = declared;
    frames_.clear();
    markup_.clear();
    listed_.clear();
    if (selection_.writesNulls && declared != nullptr)
        for (const auto& property : declared->properties)
            if (isSelected(selection_, declared, property->name))
                listed_.push_back(property->name);
}

void InstanceMarkup::writeArray(std::string& out, const Array& array, Frame& frame)
{
    const auto isSame = [&](const Array& last) {
        return std::equal(last.elements().begin(), last.elements().end(), array.elements().begin(),
            array.elements().end());
    };
    if (frame.array == nullptr || !isSame(*frame.array)) {
        frame.arrayText.clear();
        writeValue(frame.arrayText, Value::of(array));
    }
    frame.array = &array;
    out += frame.arrayText;
}

// Instances of a class mostly have the same properties in the same order.
InstanceMarkup::Frame& InstanceMarkup::frameFor(std::string_view property, const Value& value)
{
    for (std::size_t tried = 0; tried < frames_.size(); ++tried) {
        Frame& next = frames_[next_];
        next_ = next_ + 1 == frames_.size() ? 0 : next_ + 1;
        if (next.valueType == value.type() && next.isSingle == isSingle(value) &&
            next.property == property)
            return next;
    }
    const auto listed = std::find_if(listed_.begin(), listed_.end(),
        [property](std::string_view name) { return equalNames(name, property); });
    Frame& frame = frames_.emplace_back(
        Frame{std::string(property), value.type(), isSingle(value), markup_.size(), markup_.size(),
            0, static_cast<std::size_t>(listed - listed_.begin()), nullptr, {}});
    if (isSelected(selection_, declared_, property))
        frame.valueAt =
            writeFrame(markup_, property, frame.valueType, frame.isSingle, declared_, selection_);
    frame.end = markup_.size();
    return frame;
}

} // namespace Host::CimXml
