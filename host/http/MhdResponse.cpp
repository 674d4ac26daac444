// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/MhdResponse.h"

#include "host/http/PendingAnswer.h"
#include "host/http/StreamedAnswer.h"

#include <microhttpd.h>

#include <cstddef>
#include <cstdint>
#include <new>

namespace Host::Http {

namespace {

constexpr std::size_t pieceSize = std::size_t{32} << 10;

template <typename Answer>
::ssize_t readPiece(void* answer, std::uint64_t, char* to, std::size_t room)
{
    return static_cast<Answer*>(answer)->read(to, room);
}

template <typename Answer>
MHD_Response* responseFrom(Answer& answer)
{
    return ::MHD_create_response_from_callback(
        MHD_SIZE_UNKNOWN, pieceSize, &readPiece<Answer>, &answer, nullptr);
}

} // namespace

void MhdResponse::Freeing::operator()(MHD_Response* response) const
{
    ::MHD_destroy_response(response);
}

MhdResponse::MhdResponse(MHD_Response* response) : response_(response)
{
    if (!response_)
        throw std::bad_alloc();
}

MhdResponse MhdResponse::whole(const std::string& text)
{
    // The library does not change the text.
    return MhdResponse(::MHD_create_response_from_buffer(
        text.size(), const_cast<char*>(text.data()), MHD_RESPMEM_PERSISTENT));
}

MhdResponse MhdResponse::inPieces(PendingAnswer& answer)
{
    return MhdResponse(responseFrom(answer));
}

MhdResponse MhdResponse::inPieces(StreamedAnswer& answer)
{
    return MhdResponse(responseFrom(answer));
}

void MhdResponse::add(const HeaderField& field)
{
    // The library refuses an empty value. A parser removes the blank.
    const char* const value = field.value.empty() ? " " : field.value.c_str();
    if (::MHD_add_response_header(response_.get(), field.name.c_str(), value) != MHD_YES)
        throw std::bad_alloc();
}

void MhdResponse::endConnection()
{
    add({"Connection", "close"});
}

bool MhdResponse::queue(MHD_Connection& connection, unsigned status)
{
    return ::MHD_queue_response(&connection, status, response_.get()) == MHD_YES;
}

} // namespace Host::Http
