#pragma once

#include <cstdint>
#include <exception>
#include <memory>
#include <string>
#include <vector>

#include "taglibrary/Client.h"
#include "taglibrary/TagData.h"
#include "taglibrary/exports/ProcessState.h"

namespace Korvane::Veldra::TagLibrary {

// The text and code of a registered error name, from the current registry,
// or from the fixed table when a caller comes without a reservation.
int32_t FormatNamedError(const std::string& name, const std::vector<std::string>& inserts,
                         std::string& text);

// Writes the text of `name` (no inserts) to the error out-parameter and
// returns its code.
template <typename ErrorOut>
int32_t ReportNamedError(const std::string& name, ErrorOut& out) {
    std::string text;
    const int32_t code = FormatNamedError(name, {}, text);
    return out.Report(code, text);
}

// "An unexpected exception occurred: " with what() as the insert.
template <typename ErrorOut>
int32_t ReportUnexpected(const std::exception& exception, ErrorOut& out) {
    std::string text;
    const int32_t code = FormatNamedError("Veldra.UnexpectedException", {exception.what()}, text);
    return out.Report(code, text);
}

// Runs the body of an exported function; a std::exception that escapes it is
// reported as unexpected. Other exception types pass through.
template <typename ErrorOut, typename Body>
int32_t RunInFrame(ErrorOut& out, Body&& body) {
    try {
        return body();
    } catch (const std::exception& exception) {
        return ReportUnexpected(exception, out);
    }
}

// The live Client of an instance id; null while the table holds none.
std::shared_ptr<Client> LookupClient(uint64_t instanceId);
// The record behind a tag reference, or null.
std::shared_ptr<TagData> LookupTag(uint32_t tagReference);

template <typename ErrorOut>
int32_t FindClient(uint64_t instanceId, std::shared_ptr<Client>& client, ErrorOut& out) {
    client = LookupClient(instanceId);
    return client ? 0 : ReportNamedError("Tag.InvalidTagReference", out);
}

// Resolves a reference to its record and the Client that owns it. The two
// look-ups lock separately, so the instance may vanish between them; that is
// then an ordinary invalid reference.
template <typename ErrorOut>
int32_t FindTag(uint32_t tagReference, std::shared_ptr<Client>& client,
                std::shared_ptr<TagData>& tag, ErrorOut& out) {
    tag = tagReference == 0 ? nullptr : LookupTag(tagReference);
    if (!tag) return ReportNamedError("Tag.InvalidTagReference", out);
    return FindClient(tag->instanceId, client, out);
}

// Puts the record in the reference table under its reference, replacing an
// existing entry.
void RegisterReference(const std::shared_ptr<TagData>& tag);
// Puts the record in the table only when its reference is absent there.
void RegisterReferenceIfAbsent(const std::shared_ptr<TagData>& tag);
// The same for several records, under one lock.
void RegisterReferencesIfAbsent(const std::vector<std::shared_ptr<TagData>>& tags);
void EraseReference(uint32_t tagReference);
// The records behind the references that the table holds, in order, of
// whichever instance; `missing` tells whether any reference was left out.
std::vector<std::shared_ptr<TagData>> LookupTags(const std::vector<uint32_t>& references,
                                                 bool& missing);

// Closes one session of a tag and, when it was the last, drops its reference.
template <typename ErrorOut>
int32_t CloseTagReference(uint32_t tagReference, const std::shared_ptr<Client>& client,
                          const std::shared_ptr<TagData>& tag, ErrorOut& out) {
    bool last = false;
    std::string text;
    const int32_t status = client->CloseTag(tag, last, text);
    if (status != 0) return out.Report(status, text);
    if (last) EraseReference(tagReference);
    return 0;
}

}  // namespace Korvane::Veldra::TagLibrary
