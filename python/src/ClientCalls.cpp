#include "ClientCalls.h"

#include "Records.h"
#include "Status.h"

namespace py = pybind11;

namespace kvveldra_python {
namespace {

constexpr int32_t kInvalidTagPath = -251904;

struct Page {
    std::vector<std::shared_ptr<TagHandle>> tags;
    uint32_t total = 0;
};

// Runs the listing and adopts every reference it opened.
Page RunList(Session& session, const ListQuery& query) {
    std::vector<int32_t> types;
    std::vector<std::string> paths;
    std::vector<uint32_t> references;
    Page page;
    std::string error;
    const int32_t status = session.Run(error, [&](std::string& text) {
        return TagConsoleListTag(session.Instance(), &query.patterns, &query.properties,
                                 &query.keywords, query.skip, query.take, true, false, &types,
                                 &paths, &references, &page.total, &text);
    });
    for (std::size_t i = 0; i < references.size(); ++i) {
        page.tags.push_back(TagHandle::Adopt(session, references[i],
                                             i < paths.size() ? paths[i] : std::string(),
                                             i < types.size() ? types[i] : -1));
    }
    if (status == 1) return Page{};
    CheckStatus(status, error);
    return page;
}

}  // namespace

std::shared_ptr<TagHandle> OpenTag(Session& session, const std::string& path) {
    if (path.empty() || path.find('*') != std::string::npos) {
        RaiseStatus(kInvalidTagPath, "Invalid tag path: '" + path +
                                         "'. open takes one plain path; list takes patterns.");
    }
    // The listing's other tags, if any, are closed as they go.
    for (auto& tag : RunList(session, ListQuery{{path}, 0, 0, {}, {}}).tags) {
        if (tag->Path() == path) return tag;
    }
    RaiseStatus(kNoSuchTag, "No such tag: '" + path + "'.");
}

std::shared_ptr<TagHandle> CreateTag(Session& session, const std::string& path, int32_t type) {
    uint32_t reference = 0;
    session.Checked([&](std::string& error) {
        return TagConsoleOpen(session.Instance(), &path, type, false, &reference, &error);
    });
    return TagHandle::Adopt(session, reference, path, type);
}

py::object ListTags(Session& session, const ListQuery& query) {
    Page page = RunList(session, query);
    py::list tags;
    for (auto& tag : page.tags) tags.append(py::cast(std::move(tag)));
    return ListingRecord(std::move(tags), page.total);
}

py::list ReadValues(Session& session, const std::vector<std::shared_ptr<TagHandle>>& tags) {
    std::vector<uint32_t> references;
    for (const auto& tag : tags) {
        if (&tag->Owner() != &session) {
            throw py::value_error("kvveldra: tag '" + tag->Path() +
                                  "' belongs to another Client; read it through that one");
        }
        tag->Require();
        references.push_back(tag->Reference());
    }
    py::list values;
    if (references.empty()) return values;
    std::vector<TagConsoleValue> results;
    session.Checked([&](std::string& error) {
        return TagConsoleReadValues(session.Instance(), &references, false, 0, &results, &error);
    });
    for (const auto& result : results) values.append(ValueRecord(result));
    return values;
}

}  // namespace kvveldra_python
