// Host functions that answer from the local tag records, with no bus traffic.
#include "kvveldra/TagWB.h"
#include "taglibrary/exports/ErrorOut.h"
#include "taglibrary/exports/Frame.h"

using namespace Korvane::Veldra::TagLibrary;

int32_t TagWBClose(uint32_t tagReference, WBStrHandle* error) {
    HostErrorOut out(error);
    return RunInFrame(out, [&] {
        std::shared_ptr<Client> client;
        std::shared_ptr<TagData> tag;
        if (const int32_t status = FindTag(tagReference, client, tag, out)) return status;
        return CloseTagReference(tagReference, client, tag, out);
    });
}

int32_t TagWBGetDataType(uint32_t tagReference, int32_t* dataType, WBStrHandle* error) {
    HostErrorOut out(error);
    return RunInFrame(out, [&] {
        if (dataType == nullptr) return 1;
        std::shared_ptr<Client> client;
        std::shared_ptr<TagData> tag;
        if (const int32_t status = FindTag(tagReference, client, tag, out)) return status;
        std::string text;
        const int32_t status = client->GetDataType(tag, *dataType, text);
        return status == 0 ? 0 : out.Report(status, text);
    });
}
