// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/operations/ObjectResponse.h"

#include "host/broker/Arena.h"

#include <utility>
#include <variant>

namespace Host {

namespace {

// The size of a piece, to which the last object in it adds.
constexpr std::size_t portion = std::size_t{16} * 1024;

// Makes an arena of its own current, so that the paths which instances make are not kept with the
// request.
class ScratchArena {
public:
    ScratchArena() : before_(Arena::makeCurrent(&arena_)) {}
    ~ScratchArena() { Arena::makeCurrent(before_); }
    ScratchArena(const ScratchArena&) = delete;
    ScratchArena& operator=(const ScratchArena&) = delete;

private:
    Arena arena_;
    Arena* before_;
};

// Appends an object as the writer does for its kind.
struct Write {
    CimXml::ResponseWriter& writer;
    std::string& out;

    void operator()(const Instance* instance) const { writer.instance(out, *instance); }
    void operator()(const ObjectPath* path) const { writer.path(out, *path); }
    void operator()(const ClassDeclaration* declared) const
    {
        writer.classDeclaration(out, *declared);
    }
    void operator()(ClassName name) const { writer.className(out, name.text); }
    void operator()(const QualifierDeclaration* declared) const
    {
        writer.qualifierDeclaration(out, *declared);
    }
    void operator()(const Value& value) const { writer.value(out, value); }
};

} // namespace

ObjectResponse::ObjectResponse(const CimXml::Message& message, CimXml::OperationKind kind,
    const Repository& classes, CimXml::Location location, CimXml::ObjectSelection selection,
    FoundObjects objects, std::optional<Continuation> continuation)
    : objects_(std::move(objects)), continuation_(std::move(continuation)),
      writer_(message, kind, classes, std::move(location), std::move(selection))
{
}

bool ObjectResponse::append(std::string& out)
{
    if (isFinished_)
        return false;
    const ScratchArena scratch;
    const std::size_t enough = out.size() + portion;
    if (next_ == 0)
        writer_.begin(out);
    while (next_ < objects_.size() && out.size() < enough)
        std::visit(Write{writer_, out}, objects_[next_++]);
    if (next_ == objects_.size())
        finish(out);
    return true;
}

void ObjectResponse::finish(std::string& out)
{
    if (continuation_)
        writer_.finish(out, continuation_->context);
    else
        writer_.finish(out);
    isFinished_ = true;
    objects_ = {}; // frees them before the response is destroyed
}

bool WrittenResponse::append(std::string& out)
{
    if (text_.empty())
        return false;
    out += text_;
    text_.clear();
    return true;
}

} // namespace Host
