#pragma once
// QelHostWebServer: serves the review page and its API on 127.0.0.1 only. The HTTP
// library's threads check each request (peer, Host header, token), read the page's files
// and queue every API call as a job for the UI thread, then wait for its reply: they never
// touch a host object. Each connection gets a worker thread, up to a cap, and serves one
// request. Run is the UI thread's loop; it returns once the stop flag is set,
// which a signal handler may do. Stop (or the destructor) ends the HTTP threads.
#include <atomic>
#include <condition_variable>
#include <csignal>
#include <deque>
#include <functional>
#include <memory>
#include <mutex>
#include <string>
#include <thread>

#include "QelHostWebApi.h"

namespace httplib {
class Server;
struct Request;
struct Response;
}  // namespace httplib

class QelHostWebServer {
 public:
  // `webFolder` holds index.html, app.js and app.css.
  QelHostWebServer(QelHostWebApi& api, std::string webFolder, std::string token);
  ~QelHostWebServer();
  QelHostWebServer(const QelHostWebServer&) = delete;
  QelHostWebServer& operator=(const QelHostWebServer&) = delete;

  // Listens on 127.0.0.1:`port` (0: a free port). False with `error` when it cannot.
  bool Start(int port, std::string& error);
  int Port() const { return port_; }
  // The page's address with its token, for the person to open.
  std::string Address() const;
  // Runs the queued API calls until `stop` is non-zero.
  void Run(const volatile std::sig_atomic_t& stop);
  void Stop();

  // 32 hex digits from the system's random source.
  static std::string MakeToken();
  // <resources>/web, beside the catalogs.
  static std::string WebFolder();

  // `qelhost serve`: serves `root` (the session takes it over) until SIGINT or SIGTERM,
  // then closes the session and saves the settings. Nothing of the model is left when it
  // returns, so the caller may unload the plug-in `module`. The exit code.
  static int Serve(QelBaseUnknown_var root, const std::string& name, int port, void* module);

 private:
  struct Job {
    std::function<QelHostWebReply()> work;
    QelHostWebReply reply;
    bool done = false;
  };

  QelHostWebReply OnUiThread(std::function<QelHostWebReply()> work);
  // False (the response filled with the refusal) for a request from elsewhere or
  // without the token.
  bool Admit(const httplib::Request& request, httplib::Response& response) const;
  // False (the response filled) for a body too large to read, judged by its stated length.
  bool AdmitBody(const httplib::Request& request, httplib::Response& response) const;
  void Routes();

  QelHostWebApi& api_;
  std::string webFolder_;
  std::string token_;
  int port_ = 0;
  std::unique_ptr<httplib::Server> http_;
  std::thread listener_;
  std::atomic<bool> listenerDone_{false};

  std::mutex mutex_;
  std::condition_variable wake_;  // a job was queued
  std::condition_variable done_;  // a job was answered
  std::deque<std::shared_ptr<Job>> jobs_;
  bool stopping_ = false;
};
