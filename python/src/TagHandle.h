#pragma once

#include <atomic>
#include <cstdint>
#include <memory>
#include <string>

#include "Session.h"

namespace kvveldra_python {

// One open tag reference of a session, behind one kvveldra.Tag: it owes the
// library one close, which it gives at the first of Tag.close(), the close of
// its Client, or its own end.
class TagHandle {
public:
    TagHandle(std::shared_ptr<Session> session, uint32_t reference, std::string path,
              int32_t dataType);
    ~TagHandle();
    TagHandle(const TagHandle&) = delete;
    TagHandle& operator=(const TagHandle&) = delete;

    // Opens one reference in a session and tracks it there.
    static std::shared_ptr<TagHandle> Adopt(Session& session, uint32_t reference,
                                            std::string path, int32_t dataType);

    Session& Owner() const { return *session_; }
    uint32_t Reference() const { return reference_; }
    const std::string& Path() const { return path_; }
    int32_t DataType() const { return dataType_; }
    bool Open() const { return open_ && !session_->Closed(); }

    // Raises kvveldra.ClosedError when the tag or its Client is closed.
    void Require() const;
    // Closes the reference unless it was closed already; its status. Needs no GIL.
    int32_t CloseReference(std::string& error);
    int32_t CloseReference() {
        std::string ignored;
        return CloseReference(ignored);
    }

private:
    const std::shared_ptr<Session> session_;
    const uint32_t reference_;
    const std::string path_;
    const int32_t dataType_;
    std::atomic<bool> open_{true};
};

}  // namespace kvveldra_python
