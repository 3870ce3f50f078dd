// Console functions that answer from the local tag records, with no bus traffic.
#include "kvveldra/TagConsole.h"
#include "taglibrary/exports/ConsoleCall.h"

using namespace Korvane::Veldra::TagLibrary;

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
