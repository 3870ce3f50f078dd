#pragma once

#include <pybind11/pybind11.h>
#include <kvveldra/TagConsole.h>

#include <memory>
#include <string>
#include <vector>

#include "Session.h"
#include "TagHandle.h"

namespace kvveldra_python {

// The calls of a kvveldra.Client on its session.

// The tag of a path that the service has, found by a listing of the path
// (so that nothing is created): kvveldra.NoSuchTagError when there is none.
std::shared_ptr<TagHandle> OpenTag(Session& session, const std::string& path);
// The tag of a path, created with the data type when the service has none.
std::shared_ptr<TagHandle> CreateTag(Session& session, const std::string& path, int32_t type);

struct ListQuery {
    std::vector<std::string> patterns;
    uint32_t skip = 0;
    uint32_t take = 0;
    TagConsoleProperties properties;
    std::vector<std::string> keywords;
};
// A kvveldra.Listing of one page; a status of 1 is an empty page.
pybind11::object ListTags(Session& session, const ListQuery& query);

// The kvveldra.Value of each tag, in the service's order; none for no tags.
pybind11::list ReadValues(Session& session, const std::vector<std::shared_ptr<TagHandle>>& tags);

}  // namespace kvveldra_python
