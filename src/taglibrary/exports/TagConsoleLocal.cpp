// Console functions that answer from the local tag records, with no bus traffic.
#include "kvveldra/TagConsole.h"
#include "taglibrary/exports/ErrorOut.h"
#include "taglibrary/exports/Frame.h"

using namespace Korvane::Veldra::TagLibrary;

namespace {

// Resolves the reference and sets the Client's verbose flag; the common head
// of every console function that takes a tag reference.
int32_t FindConsoleTag(uint32_t tagReference, bool verbose, std::shared_ptr<Client>& client,
                       std::shared_ptr<TagData>& tag, ConsoleErrorOut& out) {
    if (tagReference == 0) return ReportNamedError("Tag.InvalidTagReference", out);
    const int32_t status = FindTag(tagReference, client, tag, out);
    if (status == 0) client->SetVerbose(verbose);
    return status;
}

}  // namespace

int32_t TagConsoleClose(uint32_t tagReference, bool verbose, std::string* error) {
    ConsoleErrorOut out(error);
    return RunInFrame(out, [&] {
        std::shared_ptr<Client> client;
        std::shared_ptr<TagData> tag;
        if (const int32_t status = FindConsoleTag(tagReference, verbose, client, tag, out)) {
            return status;
        }
        return CloseTagReference(tagReference, client, tag, out);
    });
}

int32_t TagConsoleGetDataType(uint32_t tagReference, bool verbose, int32_t* dataType,
                              std::string* error) {
    ConsoleErrorOut out(error);
    return RunInFrame(out, [&] {
        std::shared_ptr<Client> client;
        std::shared_ptr<TagData> tag;
        if (const int32_t status = FindConsoleTag(tagReference, verbose, client, tag, out)) {
            return status;
        }
        if (dataType == nullptr) return 1;
        std::string text;
        const int32_t status = client->GetDataType(tag, *dataType, text);
        return status == 0 ? 0 : out.Report(status, text);
    });
}

int32_t TagConsoleGetPath(uint32_t tagReference, bool verbose, std::string* path,
                          std::string* error) {
    ConsoleErrorOut out(error);
    return RunInFrame(out, [&] {
        std::shared_ptr<Client> client;
        std::shared_ptr<TagData> tag;
        if (const int32_t status = FindConsoleTag(tagReference, verbose, client, tag, out)) {
            return status;
        }
        if (path == nullptr) return 1;
        std::string text;
        const int32_t status = client->GetPath(tag, *path, text);
        return status == 0 ? 0 : out.Report(status, text);
    });
}
