#include "HttpServer.h"

#include <array>
#include <boost/asio/dispatch.hpp>
#include <boost/asio/post.hpp>
#include <boost/asio/strand.hpp>
#include <boost/beast/core.hpp>
#include <boost/beast/http.hpp>
#include <optional>

namespace kvtag::serve {
namespace {

namespace asio = boost::asio;
namespace beast = boost::beast;
namespace http = beast::http;
using tcp = asio::ip::tcp;

// Scripts and styles from this server only, no eval, no frames, no forms
// sent anywhere, no plugins.
constexpr const char* kContentSecurityPolicy =
    "default-src 'none'; script-src 'self'; style-src 'self'; connect-src 'self'; "
    "img-src 'self'; base-uri 'none'; form-action 'none'; frame-ancestors 'none'";

// After an answer that ends the connection, what the client still sends
// is read and dropped for a while, so that closing does not reset the
// connection before the client has read the answer.
constexpr std::chrono::seconds kDrainTime{2};
constexpr std::size_t kDrainBytes = 1024 * 1024;

class Session : public std::enable_shared_from_this<Session> {
public:
    Session(tcp::socket socket, std::shared_ptr<const RequestHandler> handler, HttpLimits limits)
        : stream_(std::move(socket)), handler_(std::move(handler)), limits_(limits) {}

    void Start() {
        asio::dispatch(stream_.get_executor(), [self = shared_from_this()] { self->Read(); });
    }

private:
    void Read() {
        parser_.emplace();
        parser_->header_limit(static_cast<std::uint32_t>(limits_.headerBytes));
        parser_->body_limit(limits_.bodyBytes);
        stream_.expires_after(limits_.readTimeout);
        http::async_read(stream_, buffer_, *parser_,
                         [self = shared_from_this()](beast::error_code error, std::size_t) {
                             self->OnRead(error);
                         });
    }

    void OnRead(beast::error_code error) {
        if (error == http::error::body_limit) {
            Send(ErrorResponse(413, "the request body is over " +
                                        std::to_string(limits_.bodyBytes) + " bytes"),
                 false);
            return;
        }
        if (error == http::error::header_limit) {
            Send(ErrorResponse(431, "the request's header is over " +
                                        std::to_string(limits_.headerBytes) + " bytes"),
                 false);
            return;
        }
        if (error &&
            error.category() == http::make_error_code(http::error::bad_target).category() &&
            error != http::error::end_of_stream && error != http::error::partial_message) {
            Send(ErrorResponse(400, "malformed HTTP request: " + error.message()), false);
            return;
        }
        if (error) {
            Close();  // gone, timed out or cut short: nobody to answer
            return;
        }
        const auto& message = parser_->get();
        version_ = message.version();
        keepAlive_ = message.keep_alive();
        HttpRequest request{std::string(message.method_string()), std::string(message.target()),
                            message.body(), std::string(message[kTokenHeader]),
                            std::string(message[http::field::host])};
        (*handler_)(std::move(request), [self = shared_from_this()](HttpResponse response) {
            asio::post(self->stream_.get_executor(),
                       [self, response = std::move(response)]() mutable {
                           self->Send(std::move(response), self->keepAlive_);
                       });
        });
    }

    void Send(HttpResponse response, bool keepAlive) {
        auto message = std::make_shared<http::response<http::string_body>>(
            static_cast<http::status>(response.status), version_);
        message->set(http::field::server, "kvtag");
        message->set(http::field::content_type, response.contentType);
        message->set(http::field::cache_control, "no-store");
        message->set("Content-Security-Policy", kContentSecurityPolicy);
        message->set("X-Content-Type-Options", "nosniff");
        message->set("X-Frame-Options", "DENY");
        message->set("Referrer-Policy", "no-referrer");
        for (const auto& [name, value] : response.headers) message->set(name, value);
        message->keep_alive(keepAlive);
        message->body() = std::move(response.body);
        message->prepare_payload();
        stream_.expires_after(limits_.writeTimeout);
        http::async_write(
            stream_, *message,
            [self = shared_from_this(), message](beast::error_code error, std::size_t) {
                if (error) {
                    self->Close();
                } else if (message->keep_alive()) {
                    self->Read();
                } else {
                    self->Drain();
                }
            });
    }

    void Drain() {
        beast::error_code ignored;
        stream_.socket().shutdown(tcp::socket::shutdown_send, ignored);
        stream_.expires_after(kDrainTime);
        DrainSome();
    }

    void DrainSome() {
        stream_.async_read_some(
            asio::buffer(drain_),
            [self = shared_from_this()](beast::error_code error, std::size_t count) {
                self->drained_ += count;
                if (error || self->drained_ > kDrainBytes) {
                    self->Close();
                } else {
                    self->DrainSome();
                }
            });
    }

    void Close() {
        beast::error_code ignored;
        stream_.socket().shutdown(tcp::socket::shutdown_both, ignored);
        stream_.socket().close(ignored);
    }

    beast::tcp_stream stream_;
    beast::flat_buffer buffer_;
    std::optional<http::request_parser<http::string_body>> parser_;
    std::shared_ptr<const RequestHandler> handler_;
    HttpLimits limits_;
    unsigned version_ = 11;
    bool keepAlive_ = false;
    std::array<char, 4096> drain_{};
    std::size_t drained_ = 0;
};

}  // namespace

HttpServer::HttpServer(asio::io_context& io, const tcp::endpoint& endpoint, RequestHandler handler,
                       HttpLimits limits)
    : io_(io),
      acceptor_(io, endpoint),
      handler_(std::make_shared<const RequestHandler>(std::move(handler))),
      limits_(limits) {}

void HttpServer::Start() {
    Accept();
}

void HttpServer::Stop() {
    beast::error_code ignored;
    acceptor_.close(ignored);
}

void HttpServer::Accept() {
    acceptor_.async_accept(
        asio::make_strand(io_), [this](beast::error_code error, tcp::socket socket) {
            if (error == asio::error::operation_aborted || !acceptor_.is_open()) return;
            if (!error) std::make_shared<Session>(std::move(socket), handler_, limits_)->Start();
            Accept();
        });
}

}  // namespace kvtag::serve
