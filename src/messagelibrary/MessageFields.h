#pragma once

#include <type_traits>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/json/JsonWriters.h"

// One list of fields for the writer and the reader of a message class.
//
// A class names its fields once, in their written order, in a static member
// template that both directions call:
//
//     template <typename Self, typename Fields>
//     static void JsonFields(Self& self, Fields& fields) {
//         fields.Field("paths", self.paths_).Field("allowStale", self.allowStale_);
//     }
//
// Serialize() is then `return WriteMessageFields(*this);` and the parsing
// constructor's body `ReadMessageFields(*this, body);`. Writing calls the list
// with a const object and a JsonBodyWriter, reading with the object being
// filled and a JsonBodyReader, so a field can never be written in one order
// and read in another. A class that keeps the list private names
// JsonFieldAccess its friend (qualified, `friend struct
// VeldraMessageLibrary::JsonFieldAccess;`, from a family's namespace). Records list their fields the same way (see
// JsonReaders.h and JsonWriters.h).

namespace Korvane::Veldra::VeldraMessageLibrary {

struct JsonFieldAccess {
    template <typename Self, typename Fields>
    static void List(Self& self, Fields& fields) {
        std::remove_const_t<Self>::JsonFields(self, fields);
    }
};

template <typename M>
MessageBus::MessageBody WriteMessageFields(const M& message) {
    JsonBodyWriter writer;
    JsonFieldAccess::List(message, writer);
    return MessageBus::MessageBody(writer.Finish());
}

// A malformed body or a refused field throws as JsonBodyReader tells.
template <typename M>
void ReadMessageFields(M& message, const MessageBus::MessageBody& body) {
    const JsonVariant json = ParseJsonBody(body.ToString(), message.MessageType());
    const JsonBodyReader reader(json);
    JsonFieldAccess::List(message, reader);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary
