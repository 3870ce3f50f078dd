#include "TagHandle.h"

#include <kvveldra/TagConsole.h>

namespace kvveldra_python {

TagHandle::TagHandle(std::shared_ptr<Session> session, uint32_t reference, std::string path,
                     int32_t dataType)
    : session_(std::move(session)),
      reference_(reference),
      path_(std::move(path)),
      dataType_(dataType) {}

TagHandle::~TagHandle() {
    CloseReference();
}

std::shared_ptr<TagHandle> TagHandle::Adopt(Session& session, uint32_t reference,
                                            std::string path, int32_t dataType) {
    auto tag = std::make_shared<TagHandle>(session.shared_from_this(), reference,
                                           std::move(path), dataType);
    session.Track(tag);
    return tag;
}

void TagHandle::Require() const {
    if (session_->Closed()) RaiseClosed(session_->ClosedText());
    if (!open_) RaiseClosed("kvveldra: the tag '" + path_ + "' is closed; open it again");
}

int32_t TagHandle::CloseReference(std::string& error) {
    if (!open_.exchange(false)) return 0;
    return TagConsoleClose(reference_, false, &error);
}

}  // namespace kvveldra_python
