#include "messagelibrary/MessageIdentity.h"

#include <boost/uuid/random_generator.hpp>
#include <boost/uuid/uuid.hpp>
#include <boost/uuid/uuid_io.hpp>

namespace Korvane::Veldra::MessageBus {

std::string NewMessageId() {
    // A fresh generator per id draws straight from the operating system's
    // entropy source, so ids need no shared generator and no lock.
    boost::uuids::random_generator generator;
    return boost::uuids::to_string(generator());
}

}  // namespace Korvane::Veldra::MessageBus
