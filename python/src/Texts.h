#pragma once

#include <pybind11/pybind11.h>
#include <kvveldra/TagConsole.h>

#include <string>
#include <vector>

namespace kvveldra_python {

// The texts of an iterable of str (not a str itself); TypeError naming
// `what` for anything else.
std::vector<std::string> TextList(pybind11::handle texts, const std::string& what);
// The pairs of a mapping of str to str; TypeError naming `what` otherwise.
TagConsoleProperties TextMap(pybind11::handle mapping, const std::string& what);

}  // namespace kvveldra_python
