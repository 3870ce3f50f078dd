#include "StdinLines.h"

#include <map>

#include "CommandLine.h"
#include "TimeText.h"

namespace kvtag {
namespace {

bool IsBlank(char c) {
    return c == ' ' || c == '\t' || c == '\r';
}

// The words of a line, quotes and escapes resolved.
std::vector<std::string> SplitWords(const std::string& text, std::size_t lineNumber) {
    std::vector<std::string> words;
    std::size_t pos = 0;
    for (;;) {
        while (pos < text.size() && IsBlank(text[pos])) ++pos;
        if (pos >= text.size()) return words;
        std::string word;
        if (text[pos] == '"') {
            ++pos;
            bool closed = false;
            while (pos < text.size()) {
                const char c = text[pos++];
                if (c == '"') {
                    closed = true;
                    break;
                }
                if (c == '\\') {
                    if (pos >= text.size() || (text[pos] != '"' && text[pos] != '\\')) {
                        throw LineError(lineNumber, "in quotes a backslash goes before \" or \\");
                    }
                    word += text[pos++];
                    continue;
                }
                word += c;
            }
            if (!closed) throw LineError(lineNumber, "a quote is not closed");
            if (pos < text.size() && !IsBlank(text[pos])) {
                throw LineError(lineNumber, "a blank goes after a closing quote");
            }
        } else {
            while (pos < text.size() && !IsBlank(text[pos])) {
                if (text[pos] == '"') throw LineError(lineNumber, "a quote inside a word");
                word += text[pos++];
            }
        }
        words.push_back(std::move(word));
    }
}

}  // namespace

std::optional<StdinLine> ParseStdinLine(const std::string& text, std::size_t lineNumber) {
    std::size_t first = 0;
    while (first < text.size() && IsBlank(text[first])) ++first;
    if (first == text.size() || text[first] == '#') return std::nullopt;

    const auto words = SplitWords(text, lineNumber);
    if (words.size() < 2 || words.size() > 3) {
        throw LineError(lineNumber, "a line is PATH VALUE [TIME], found " +
                                        std::to_string(words.size()) + " word(s)");
    }
    if (const auto problem = TagPathProblem(words[0])) throw LineError(lineNumber, *problem);
    StdinLine line;
    line.lineNumber = lineNumber;
    line.path = words[0];
    line.value = words[1];
    if (words.size() == 3) {
        line.time = ParseIsoTime(words[2]);
        if (!line.time && LacksOnlyAZone(words[2])) {
            throw LineError(lineNumber, "the time '" + words[2] + "' has no zone: " + kAddAZone);
        }
        if (!line.time) {
            throw LineError(lineNumber, "'" + words[2] + "' is not an ISO 8601 time with a zone");
        }
    }
    return line;
}

std::vector<TagBatch> ReadStdinBatches(std::istream& in) {
    std::vector<TagBatch> batches;
    std::map<std::string, std::size_t> indexOfPath;
    std::string text;
    std::size_t lineNumber = 0;
    while (std::getline(in, text)) {
        ++lineNumber;
        auto line = ParseStdinLine(text, lineNumber);
        if (!line) continue;
        const auto [entry, added] = indexOfPath.emplace(line->path, batches.size());
        if (added) batches.push_back(TagBatch{line->path, {}});
        batches[entry->second].lines.push_back(std::move(*line));
    }
    if (batches.empty()) throw LineError(lineNumber, "no PATH VALUE line was given");
    return batches;
}

}  // namespace kvtag
