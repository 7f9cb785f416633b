#include "QelHostWebServer.h"

#include <httplib.h>
#include <sys/socket.h>

#include <algorithm>
#include <chrono>
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <iostream>
#include <random>
#include <nlohmann/json.hpp>
#include <sstream>

#include "QelDelayedDestruction.h"
#include "QelHostSession.h"
#include "QelHostWebRequest.h"
#include "QelHostWebTaskQueue.h"
#include "QelMsgCatalog.h"
#include "QelSettingRepository.h"

namespace {
constexpr const char* kLoopback = "127.0.0.1";
constexpr const char* kCookie = "qeltoken";
// Connections get a worker each up to this many, so that idle or trickling sockets cannot
// hold them all; a few stay warm for the page's next requests.
constexpr size_t kWarmWorkers = 8, kMostWorkers = 512;
constexpr std::chrono::seconds kWorkerLinger{10};

volatile std::sig_atomic_t stopRequested = 0;
extern "C" void RequestStop(int) { stopRequested = 1; }

// Equal texts, in a time that does not tell how much of a guess was right.
bool SameSecret(const std::string& a, const std::string& b) {
  if (a.size() != b.size()) return false;
  unsigned char diff = 0;
  for (size_t i = 0; i < a.size(); ++i) diff |= static_cast<unsigned char>(a[i] ^ b[i]);
  return diff == 0;
}

bool IsLoopbackPeer(const std::string& address) {
  return address.rfind("127.", 0) == 0 || address == "::1" || address.rfind("::ffff:127.", 0) == 0;
}

void Refuse(httplib::Response& response, int status, const std::string& reason) {
  response.status = status;
  response.set_content(reason + "\n", "text/plain; charset=utf-8");
}

void Send(httplib::Response& response, QelHostWebReply reply) {
  response.status = reply.status;
  response.set_content(std::move(reply.body), reply.contentType.c_str());
}

int Dimension(const httplib::Request& request, const char* name, int fallback) {
  if (!request.has_param(name)) return fallback;
  const std::string text = request.get_param_value(name);
  char* end = nullptr;
  const long value = std::strtol(text.c_str(), &end, 10);
  if (text.empty() || *end != '\0') return fallback;
  return static_cast<int>(std::clamp(value, 0L, 100000L));  // the API clamps further
}
}  // namespace

QelHostWebServer::QelHostWebServer(QelHostWebApi& api, std::string webFolder, std::string token)
    : api_(api), webFolder_(std::move(webFolder)), token_(std::move(token)), http_(std::make_unique<httplib::Server>()) {
  Routes();
}

QelHostWebServer::~QelHostWebServer() { Stop(); }

std::string QelHostWebServer::MakeToken() {
  std::random_device random;
  std::string token;
  static constexpr char kHex[] = "0123456789abcdef";
  for (int i = 0; i < 4; ++i) {
    uint32_t bits = random();
    for (int n = 0; n < 8; ++n, bits >>= 4) token += kHex[bits & 0xF];
  }
  return token;
}

std::string QelHostWebServer::WebFolder() {
  return (std::filesystem::path(QelMsgCatalog::CatalogFolder()).parent_path() / "web").string();
}

std::string QelHostWebServer::Address() const {
  return "http://" + std::string(kLoopback) + ":" + std::to_string(port_) + "/?token=" + token_;
}

bool QelHostWebServer::Admit(const httplib::Request& request, httplib::Response& response) const {
  if (!IsLoopbackPeer(request.remote_addr)) {
    Refuse(response, 403, "only this machine may connect");
    return false;
  }
  // A page of another site that resolves its own name to this machine names that site.
  const std::string host = request.get_header_value("Host");
  const std::string port = ":" + std::to_string(port_);
  if (host != kLoopback + port && host != "localhost" + port) {
    Refuse(response, 403, "the Host header must be 127.0.0.1" + port + " or localhost" + port);
    return false;
  }
  // A page of another port of this machine is the same site to a browser, which sends the
  // cookie with its form posts; such a page names its own origin, or "null".
  const std::string origin = request.get_header_value("Origin");
  if (request.has_header("Origin") && !QelHostWebRequest::IsOwnOrigin(origin, port_)) {
    Refuse(response, 403, "the request comes from the page at '" + origin + "', not from this server's page");
    return false;
  }
  // Any one good token will do: cookies ignore the port, so a browser that visited an
  // earlier server on this machine still sends that server's cookie with the new address.
  // A change of state needs the header, which only this page's script can set: a form
  // posted from elsewhere carries the cookie but cannot add a header.
  const bool changes = request.method != "GET" && request.method != "HEAD";
  std::vector<std::string> offered = {request.get_header_value("X-Qel-Token")};
  if (!changes) {
    if (request.method == "GET" && request.path == "/") offered.push_back(request.get_param_value("token"));
    for (std::string& value : QelHostWebRequest::CookieValues(request.get_header_value("Cookie"), kCookie))
      offered.push_back(std::move(value));
  }
  bool any = false;
  for (const std::string& given : offered) {
    if (given.empty()) continue;
    if (SameSecret(given, token_)) return true;
    any = true;
  }
  if (changes && !any) {
    Refuse(response, 403, "a change needs the access token in the X-Qel-Token header: use the page qelhost printed");
    return false;
  }
  Refuse(response, 403, any ? "the access token is wrong: open the address qelhost printed"
                            : "the access token is missing: open the address qelhost printed");
  return false;
}

bool QelHostWebServer::AdmitBody(const httplib::Request& request, httplib::Response& response) const {
  if (!request.has_header("Content-Length")) return true;
  const std::optional<size_t> length = QelHostWebRequest::ParseContentLength(request.get_header_value("Content-Length"));
  if (!length) {
    Refuse(response, 400, "the Content-Length header is not a number of bytes");
    return false;
  }
  if (*length > QelHostWebRequest::kMaxBody) {
    Refuse(response, 413, "the body is larger than " + std::to_string(QelHostWebRequest::kMaxBody) + " bytes");
    return false;
  }
  return true;
}

void QelHostWebServer::Routes() {
  httplib::Server& http = *http_;
  http.set_payload_max_length(QelHostWebRequest::kMaxBody);
  http.new_task_queue = [] { return new QelHostWebTaskQueue(kWarmWorkers, kMostWorkers, kWorkerLinger); };
  // A connection serves one request and closes: a refused body is then never read, where
  // keeping the connection would read it all to find the next request. On loopback a new
  // connection costs less than a tenth of a millisecond.
  http.set_keep_alive_max_count(1);
  // A connection that says nothing is let go soon: the library polls it meanwhile.
  http.set_keep_alive_timeout(2);
  http.set_read_timeout(5, 0);
  http.set_write_timeout(5, 0);
  // Headers and body go out as separate writes: without this the body waits for the
  // client's delayed acknowledgement of the headers, some 40 ms on loopback.
  http.set_tcp_nodelay(true);
  http.set_default_headers({{"X-Content-Type-Options", "nosniff"},
                            {"X-Frame-Options", "DENY"},
                            {"Referrer-Policy", "no-referrer"},
                            {"Cache-Control", "no-store"}});
  http.set_pre_routing_handler([this](const httplib::Request& request, httplib::Response& response) {
    return Admit(request, response) && AdmitBody(request, response) ? httplib::Server::HandlerResponse::Unhandled
                                                                    : httplib::Server::HandlerResponse::Handled;
  });

  auto file = [this](const char* name, const char* type) {
    return [this, name, type](const httplib::Request& request, httplib::Response& response) {
      std::ifstream in(std::filesystem::path(webFolder_) / name, std::ios::binary);
      std::ostringstream text;
      text << in.rdbuf();
      if (!in) return Refuse(response, 404, std::string("the page's file ") + name + " is not installed");
      std::string content = text.str();
      // The page's script sends the token with every change; only an admitted request sees
      // it, and another origin's script cannot read the answer.
      if (request.path == "/")
        if (const size_t head = content.find("<head>"); head != std::string::npos)
          content.insert(head + 6, "\n<meta name=\"qel-token\" content=\"" + token_ + "\">");
      response.set_content(content, type);
      if (request.path == "/" && request.has_param("token"))
        response.set_header("Set-Cookie", std::string(kCookie) + "=" + token_ + "; Path=/; HttpOnly; SameSite=Strict");
    };
  };
  http.Get("/", file("index.html", "text/html; charset=utf-8"));
  http.Get("/app.js", file("app.js", "text/javascript; charset=utf-8"));
  http.Get("/app.css", file("app.css", "text/css; charset=utf-8"));

  http.Get("/api/state", [this](const httplib::Request&, httplib::Response& response) {
    Send(response, OnUiThread([this] { return api_.State(); }));
  });
  http.Get("/api/picture.png", [this](const httplib::Request& request, httplib::Response& response) {
    const int width = Dimension(request, "w", 800), height = Dimension(request, "h", 600);
    Send(response, OnUiThread([this, width, height] { return api_.Picture(width, height); }));
  });
  http.Get(R"(/api/thumbnail/(\d{1,9})\.png)", [this](const httplib::Request& request, httplib::Response& response) {
    const int item = std::stoi(request.matches[1]);
    Send(response, OnUiThread([this, item] { return api_.Thumbnail(item); }));
  });

  using Call = QelHostWebReply (QelHostWebApi::*)(std::string_view);
  const std::pair<const char*, Call> posts[] = {{"/api/event", &QelHostWebApi::Event},
                                                {"/api/answer", &QelHostWebApi::Answer},
                                                {"/api/camera", &QelHostWebApi::Camera},
                                                {"/api/activate", &QelHostWebApi::Activate},
                                                {"/api/reset", &QelHostWebApi::Reset},
                                                {"/api/ui-active", &QelHostWebApi::UiActive},
                                                {"/api/open-panel", &QelHostWebApi::OpenPanel}};
  for (const auto& [path, call] : posts) {
    http.Post(path, [this, call = call](const httplib::Request&, httplib::Response& response,
                                        const httplib::ContentReader& read) {
      // A chunked body states no length: it is counted as it arrives and cut at the limit.
      std::string body;
      bool tooLarge = false;
      const bool whole = read([&](const char* data, size_t length) {
        tooLarge = body.size() + length > QelHostWebRequest::kMaxBody;
        if (!tooLarge) body.append(data, length);
        return !tooLarge;
      });
      if (tooLarge)
        return Refuse(response, 413, "the body is larger than " + std::to_string(QelHostWebRequest::kMaxBody) + " bytes");
      if (!whole) return Refuse(response, 400, "the body could not be read");
      Send(response, OnUiThread([this, call, body = std::move(body)] { return (api_.*call)(body); }));
    });
    // Without a body the library looks for a plain handler; the API then says what is missing.
    http.Post(path, [this, call = call](const httplib::Request&, httplib::Response& response) {
      Send(response, OnUiThread([this, call] { return (api_.*call)(std::string_view()); }));
    });
    // State changes only through POST.
    http.Get(path, [](const httplib::Request&, httplib::Response& response) {
      response.set_header("Allow", "POST");
      Refuse(response, 405, "this address takes POST");
    });
  }
}

bool QelHostWebServer::Start(int port, std::string& error) {
  if (port < 0 || port > 65535) {
    error = "the port " + std::to_string(port) + " is not one from 0 to 65535";
    return false;
  }
  // The library listens with a queue of 5: a burst of connections (a page opening, or
  // someone flooding it) would have the rest dropped and retried a second or more later.
  // Listening again on the bound socket lengthens the queue.
  int listening = -1;
  http_->set_socket_options([&listening](int socket) {
    const int yes = 1;
    ::setsockopt(socket, SOL_SOCKET, SO_REUSEADDR, &yes, sizeof yes);
    listening = socket;
  });
  port_ = port == 0 ? http_->bind_to_any_port(kLoopback) : (http_->bind_to_port(kLoopback, port) ? port : -1);
  if (port_ <= 0) {
    error = "cannot listen on " + std::string(kLoopback) + ":" + std::to_string(port) + " (in use?)";
    return false;
  }
  if (listening >= 0) ::listen(listening, SOMAXCONN);
  listener_ = std::thread([this] {
    http_->listen_after_bind();
    listenerDone_ = true;
  });
  // A stop asked before the listener runs would be lost, and it would accept forever.
  while (!http_->is_running() && !listenerDone_) std::this_thread::sleep_for(std::chrono::milliseconds(1));
  return true;
}

QelHostWebReply QelHostWebServer::OnUiThread(std::function<QelHostWebReply()> work) {
  auto job = std::make_shared<Job>();
  job->work = std::move(work);
  std::unique_lock lock(mutex_);
  if (stopping_) return {503, kQelJsonType, R"({"error":"qelhost is stopping"})"};
  jobs_.push_back(job);
  wake_.notify_one();
  done_.wait(lock, [&] { return job->done; });
  return std::move(job->reply);
}

void QelHostWebServer::Run(const volatile std::sig_atomic_t& stop) {
  std::unique_lock lock(mutex_);
  // The flag is polled: a signal handler may only set it, not notify.
  while (!stop) {
    wake_.wait_for(lock, std::chrono::milliseconds(50), [this] { return !jobs_.empty(); });
    while (!jobs_.empty()) {
      std::shared_ptr<Job> job = jobs_.front();
      jobs_.pop_front();
      lock.unlock();
      QelHostWebReply reply;
      try {
        reply = job->work();
      } catch (const std::exception& e) {
        reply = {500, kQelJsonType, nlohmann::json{{"error", std::string("internal error: ") + e.what()}}.dump()};
      }
      lock.lock();
      job->reply = std::move(reply);
      job->done = true;
      done_.notify_all();
    }
    // Idle once the answers are out: the picture their change made stale is drawn while the
    // page reads them, rather than once the page asks for it.
    lock.unlock();
    try {
      api_.PreparePicture();
    } catch (const std::exception&) {
      // The page's own request draws it again and says what failed.
    }
    lock.lock();
  }
}

void QelHostWebServer::Stop() {
  {
    std::lock_guard lock(mutex_);
    stopping_ = true;
    for (const auto& job : jobs_) {
      job->reply = {503, kQelJsonType, R"({"error":"qelhost is stopping"})"};
      job->done = true;
    }
    jobs_.clear();
    done_.notify_all();
  }
  http_->stop();
  if (listener_.joinable()) listener_.join();
}

int QelHostWebServer::Serve(QelBaseUnknown_var root, const std::string& name, int port, void* module) {
  // The session's own reports (each refused question) would only confuse the terminal:
  // the page shows the question.
  std::ostream quiet(nullptr);
  int code = 0;
  {
    QelHostSession session(quiet, std::cerr);
    session.SetModule(module);
    std::string error;
    if (!session.Attach(root, name, error)) {
      std::fprintf(stderr, "qelhost: %s\n", error.c_str());
      return 1;
    }
    root = nullptr;
    QelHostWebApi api(session);
    QelHostWebServer server(api, WebFolder(), MakeToken());
    if (!server.Start(port, error)) {
      std::fprintf(stderr, "qelhost: %s\n", error.c_str());
      code = 1;
    } else {
      std::signal(SIGPIPE, SIG_IGN);
      struct sigaction action = {};
      action.sa_handler = RequestStop;
      sigemptyset(&action.sa_mask);
      struct sigaction oldInt = {}, oldTerm = {};
      sigaction(SIGINT, &action, &oldInt);
      sigaction(SIGTERM, &action, &oldTerm);
      std::printf("qelhost: review at %s\n", server.Address().c_str());
      std::fflush(stdout);
      server.Run(stopRequested);
      server.Stop();
      sigaction(SIGINT, &oldInt, nullptr);
      sigaction(SIGTERM, &oldTerm, nullptr);
    }
  }
  QelDelayedDestruction::FlushIdle();
  // What the person changed through the page (the panel closed, say) outlives the run.
  if (QelSettingRepository* repository = QelSettingRepository::GetRepository("QelRovDataFiltering", 0, 0);
      repository && repository->IsModified() && repository->SaveRepository() != S_OK) {
    std::fprintf(stderr, "qelhost: could not save the settings in %s\n", repository->GetFilePath().c_str());
    code = 1;
  }
  std::printf("qelhost: stopped\n");
  std::fflush(stdout);
  return code;
}
