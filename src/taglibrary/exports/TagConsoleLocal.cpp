// Console functions that answer from the local tag records, with no bus traffic.
#include "kvveldra/TagConsole.h"
#include "taglibrary/exports/ErrorOut.h"
#include "taglibrary/exports/Frame.h"

using namespace Korvane::Veldra::TagLibrary;

namespace {

// The frame of a console function on one tag reference: resolves the
// reference, sets the Client's verbose flag, and runs `operation` with the
// Client, the record and a text for its failure.
template <typename Operation>
int32_t RunOnConsoleTag(uint32_t tagReference, bool verbose, std::string* error,
                        Operation&& operation) {
    ConsoleErrorOut out(error);
    return RunInFrame(out, [&] {
        if (tagReference == 0) return ReportNamedError("Tag.InvalidTagReference", out);
        std::shared_ptr<Client> client;
        std::shared_ptr<TagData> tag;
        if (const int32_t status = FindTag(tagReference, client, tag, out)) return status;
        client->SetVerbose(verbose);
        std::string text;
        const int32_t status = operation(*client, tag, text);
        return status == 0 ? status : out.Report(status, text);
    });
}

}  // namespace

int32_t TagConsoleClose(uint32_t tagReference, bool verbose, std::string* error) {
    return RunOnConsoleTag(
        tagReference, verbose, error,
        [&](Client& client, const std::shared_ptr<TagData>& tag, std::string& text) {
            bool last = false;
            const int32_t status = client.CloseTag(tag, last, text);
            if (status == 0 && last) EraseReference(tagReference);
            return status;
        });
}

int32_t TagConsoleGetDataType(uint32_t tagReference, bool verbose, int32_t* dataType,
                              std::string* error) {
    return RunOnConsoleTag(
        tagReference, verbose, error,
        [&](Client& client, const std::shared_ptr<TagData>& tag, std::string& text) {
            return dataType == nullptr ? 1 : client.GetDataType(tag, *dataType, text);
        });
}

int32_t TagConsoleGetPath(uint32_t tagReference, bool verbose, std::string* path,
                          std::string* error) {
    return RunOnConsoleTag(
        tagReference, verbose, error,
        [&](Client& client, const std::shared_ptr<TagData>& tag, std::string& text) {
            return path == nullptr ? 1 : client.GetPath(tag, *path, text);
        });
}
