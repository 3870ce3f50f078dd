#include "peer/RawTagPeer.h"

#include <amqp.h>
#include <sys/time.h>

#include <chrono>
#include <utility>

#include "support/BrokerEnvironment.h"
#include "support/RawAmqpConnection.h"

namespace Korvane::Veldra::Testing {
namespace {

std::string Text(const amqp_bytes_t& bytes) {
    return bytes.len == 0 ? std::string() : std::string(static_cast<const char*>(bytes.bytes), bytes.len);
}

std::string Header(const amqp_basic_properties_t& properties, const std::string& key) {
    if ((properties._flags & AMQP_BASIC_HEADERS_FLAG) == 0) return {};
    for (int i = 0; i < properties.headers.num_entries; ++i) {
        const amqp_table_entry_t& entry = properties.headers.entries[i];
        if (Text(entry.key) == key && entry.value.kind == AMQP_FIELD_KIND_UTF8) {
            return Text(entry.value.value.bytes);
        }
    }
    return {};
}

// The scripted records of the paths the request body names, joined.
std::string Records(const std::map<std::string, std::string>& script, const std::string& body,
                    bool& malformed) {
    std::string joined;
    for (const auto& [path, record] : script) {
        if (body.find('"' + path + '"') == std::string::npos) continue;
        if (record == "MALFORMED") malformed = true;
        if (!joined.empty()) joined += ',';
        joined += record;
    }
    return joined;
}

}  // namespace

RawTagPeer::RawTagPeer(std::string exchange, Script tags, Script values)
    : exchange_(std::move(exchange)), tags_(std::move(tags)), values_(std::move(values)),
      thread_([this] { Run(); }) {}

RawTagPeer::~RawTagPeer() {
    stop_ = true;
    thread_.join();
}

bool RawTagPeer::Ready() {
    auto future = ready_.get_future();
    return future.wait_for(std::chrono::seconds(15)) == std::future_status::ready && future.get();
}

std::string RawTagPeer::Answer(const std::string& type, const std::string& body,
                               std::string& answerType) const {
    bool malformed = false;
    std::string reply;
    if (type == "TagInfoQueryTagsRequest") {
        answerType = "TagInfoQueryTagsResponse";
        const std::string records = Records(tags_, body, malformed);
        const int count = records.empty() ? 0 : 1;
        reply = "{\"tags\":[" + records + "],\"totalCount\":" + std::to_string(count) + "}";
    } else if (type == "TagCvQueryCurrentValuesByPathRequest") {
        answerType = "TagCvQueryCurrentValuesByPathResponse";
        reply = "{\"values\":[" + Records(values_, body, malformed) + "]}";
    } else {
        answerType.clear();
    }
    return malformed ? std::string("{\"tags\":[{\"path\":") : reply;
}

void RawTagPeer::Run() {
    RawAmqpConnection raw;
    amqp_connection_state_t state = raw.Get();
    const bool opened = raw.OpenTcp(Broker().Host, Broker().AmqpPort) == 0 &&
                        raw.Login(Broker().User, Broker().Password) && raw.OpenChannel(1);
    if (!opened) {
        ready_.set_value(false);
        return;
    }
    amqp_exchange_declare(state, 1, amqp_cstring_bytes(exchange_.c_str()), amqp_cstring_bytes("topic"),
                          0, 1, 0, 0, amqp_empty_table);
    amqp_queue_declare_ok_t* declared =
        amqp_queue_declare(state, 1, amqp_empty_bytes, 0, 0, 1, 1, amqp_empty_table);
    if (declared == nullptr) {
        ready_.set_value(false);
        return;
    }
    const amqp_bytes_t queue = amqp_bytes_malloc_dup(declared->queue);
    for (const char* key : {"Veldra.TagInfo.#", "Veldra.TagCurrentValue.#"}) {
        amqp_queue_bind(state, 1, queue, amqp_cstring_bytes(exchange_.c_str()), amqp_cstring_bytes(key),
                        amqp_empty_table);
    }
    amqp_basic_consume(state, 1, queue, amqp_empty_bytes, 0, 1, 0, amqp_empty_table);
    amqp_bytes_free(queue);
    const bool consuming = amqp_get_rpc_reply(state).reply_type == AMQP_RESPONSE_NORMAL;
    ready_.set_value(consuming);
    while (consuming && !stop_) {
        amqp_envelope_t envelope{};
        timeval wait{0, 100000};
        amqp_maybe_release_buffers(state);
        if (amqp_consume_message(state, &envelope, &wait, 0).reply_type != AMQP_RESPONSE_NORMAL) continue;
        const amqp_basic_properties_t& in = envelope.message.properties;
        std::string answerType;
        const std::string reply = Answer(Text(in.type), Text(envelope.message.body), answerType);
        const std::string replyTo = Header(in, "ReplyTo");
        if (!answerType.empty() && !replyTo.empty()) {
            amqp_basic_properties_t out{};
            out._flags = AMQP_BASIC_CONTENT_TYPE_FLAG | AMQP_BASIC_TYPE_FLAG |
                         AMQP_BASIC_CORRELATION_ID_FLAG | AMQP_BASIC_HEADERS_FLAG;
            out.content_type = amqp_cstring_bytes("application/json");
            out.type = amqp_cstring_bytes(answerType.c_str());
            out.correlation_id = in.correlation_id;
            out.headers = amqp_empty_table;
            const std::string key = "Veldra." + replyTo + "." + answerType;
            amqp_basic_publish(state, 1, amqp_cstring_bytes(exchange_.c_str()), amqp_cstring_bytes(key.c_str()),
                               0, 0, &out, amqp_cstring_bytes(reply.c_str()));
        }
        amqp_destroy_envelope(&envelope);
    }
}

}  // namespace Korvane::Veldra::Testing
