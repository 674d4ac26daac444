// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/operations/ObjectAnswer.h"

#include <utility>
#include <variant>

namespace Host {

namespace {

// What is appended at once, give or take an object: enough for few calls, little to hold.
constexpr std::size_t portion = std::size_t{16} * 1024;

// One call of the writer for each kind of object.
struct Write {
    CimXml::AnswerWriter& writer;

    void operator()(const Instance* instance) const { writer.instance(*instance); }
    void operator()(const ObjectPath* path) const { writer.path(*path); }
    void operator()(const ClassDeclaration* declared) const { writer.classDeclaration(*declared); }
    void operator()(ClassName name) const { writer.className(name.text); }
    void operator()(const QualifierDeclaration* declared) const
    {
        writer.qualifierDeclaration(*declared);
    }
    void operator()(const Value& value) const { writer.value(value); }
};

} // namespace

ObjectAnswer::ObjectAnswer(const CimXml::Message& message, CimXml::OperationKind kind,
    const Repository& classes, CimXml::Location location, CimXml::PropertySelection selection,
    AnswerObjects objects, std::optional<Continuation> continuation)
    : objects_(std::move(objects)), continuation_(std::move(continuation)),
      writer_(message, kind, classes, std::move(location), std::move(selection),
          [this](std::string_view piece) { out_->append(piece); })
{
}

bool ObjectAnswer::append(std::string& out)
{
    if (isFinished_)
        return false;
    out_ = &out;
    const std::size_t enough = out.size() + portion;
    while (next_ < objects_.size() && out.size() < enough)
        std::visit(Write{writer_}, objects_[next_++]);
    if (next_ == objects_.size())
        finish();
    out_ = nullptr;
    return true;
}

void ObjectAnswer::finish()
{
    if (continuation_)
        writer_.finish(continuation_->context);
    else
        writer_.finish();
    isFinished_ = true;
    objects_ = {}; // whoever holds on to the answer need not hold on to its objects
}

bool WrittenAnswer::append(std::string& out)
{
    if (text_.empty())
        return false;
    out += text_;
    text_.clear();
    return true;
}

} // namespace Host
