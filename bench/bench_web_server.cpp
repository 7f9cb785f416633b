// One click on the review page as the server sees it, on generated models of 1k and 10k
// annotations: `qelhost serve` runs as its own process and each iteration posts a click
// on a panel box over loopback (the event, the display requests, the dialog's rebuild and
// the State answer with the panel JSON), then, in the second form, fetches the picture
// the click made stale (a fresh render and PNG encoding at 800 x 600). Real time: the work
// is done in the server. Two boxes: one set's (few display changes) and "Default
// annotations only" (a display request over every annotation of the visible sets).
#include <benchmark/benchmark.h>
#include <httplib.h>
#include <signal.h>
#include <sys/wait.h>
#include <unistd.h>

#include <filesystem>
#include <fstream>
#include <functional>
#include <map>
#include <memory>
#include <nlohmann/json.hpp>
#include <regex>

#include "QelModelGenerator.h"

namespace {
using json = nlohmann::json;

// The id of the visible box in the row whose label ends with `label`.
std::string BoxOf(const json& node, const std::string& label, const json* row = nullptr) {
  if (node["name"] == "PropertyLabel") {
    const std::string text = node["attributes"].value("text", "");
    if (row && text.size() >= label.size() && text.compare(text.size() - label.size(), label.size(), label) == 0) {
      std::function<std::string(const json&)> box = [&](const json& n) -> std::string {
        if (n["name"] == "CheckBox" && n["visible"] == true) return n["id"];
        for (const json& c : n["children"])
          if (std::string id = box(c); !id.empty()) return id;
        return "";
      };
      return box(*row);
    }
  }
  // A row is the nearest frame laid out as a row.
  const json* inner = node["attributes"].value("layout", "") == "row" ? &node : row;
  for (const json& child : node["children"])
    if (std::string id = BoxOf(child, label, inner); !id.empty()) return id;
  return "";
}

// The id of the first closed section that shows, in the panel's order, or "".
std::string FirstClosed(const json& node) {
  if (node["visible"] != true) return "";
  if (node.contains("expanded") && node["expanded"] == false) return node["id"];
  for (const json& child : node["children"])
    if (std::string id = FirstClosed(child); !id.empty()) return id;
  return "";
}

class Server {
 public:
  explicit Server(int annotations) {
    const auto folder = std::filesystem::temp_directory_path() / "qel-bench-web";
    std::filesystem::create_directories(folder / "settings");
    const std::string model = (folder / ("generated-" + std::to_string(annotations) + ".json")).string();
    std::ofstream(model) << QelModelGenerator::MakeModelText(annotations);
    int out[2];
    if (pipe(out) != 0) return;
    pid_ = fork();
    if (pid_ == 0) {
      dup2(out[1], STDOUT_FILENO);
      close(out[0]);
      setenv("QEL_SETTINGS_DIR", (folder / "settings").c_str(), 1);
      execl(QEL_HOST_PROGRAM, QEL_HOST_PROGRAM, "serve", model.c_str(), static_cast<char*>(nullptr));
      _exit(127);
    }
    close(out[1]);
    std::string seen;
    char buffer[4096];
    std::smatch m;
    const std::regex address(R"(http://127\.0\.0\.1:(\d+)/\?token=([0-9a-f]+))");
    for (ssize_t n; !std::regex_search(seen, m, address) && (n = read(out[0], buffer, sizeof buffer)) > 0;)
      seen.append(buffer, size_t(n));
    close(out[0]);
    if (m.empty()) return;
    client_ = std::make_unique<httplib::Client>("127.0.0.1", std::stoi(m[1]));
    headers_ = {{"X-Qel-Token", m[2]}};
  }
  ~Server() {
    client_.reset();
    if (pid_ > 0) kill(pid_, SIGTERM), waitpid(pid_, nullptr, 0);
  }
  bool Ok() const { return client_ != nullptr; }
  json State() {
    auto res = client_->Get("/api/state", headers_);
    return res && res->status == 200 ? json::parse(res->body) : json();
  }
  size_t Click(const std::string& id) {
    auto res = client_->Post("/api/event", headers_, json{{"id", id}, {"type", "click"}}.dump(), "application/json");
    return res && res->status == 200 ? res->body.size() : 0;
  }
  bool Expand(const std::string& id) {
    auto res = client_->Post("/api/event", headers_, json{{"id", id}, {"type", "expand"}}.dump(), "application/json");
    return res && res->status == 200;
  }
  size_t Picture() {
    auto res = client_->Get("/api/picture.png", headers_);
    return res && res->status == 200 ? res->body.size() : 0;
  }

 private:
  pid_t pid_ = -1;
  std::unique_ptr<httplib::Client> client_;
  httplib::Headers headers_;
};

// One server per model size for the whole run: starting one loads the model.
Server& ServerFor(int annotations) {
  static std::map<int, std::unique_ptr<Server>> servers;
  auto& server = servers[annotations];
  if (!server) server = std::make_unique<Server>(annotations);
  return *server;
}

void Click(benchmark::State& state, const char* label, bool picture) {
  Server& server = ServerFor(static_cast<int>(state.range(0)));
  // Answers carry only what a person sees: open sections, first to last, until the box shows.
  std::string box;
  for (int opened = 0; server.Ok() && box.empty() && opened < 8; ++opened) {
    const json panel = server.State()["panel"];
    box = BoxOf(panel, label);
    if (const std::string closed = box.empty() ? FirstClosed(panel) : ""; !closed.empty()) server.Expand(closed);
  }
  if (box.empty()) return state.SkipWithError("no server, or no such box on its panel");
  size_t bytes = 0;
  for (auto _ : state) {
    const size_t answer = server.Click(box);
    const size_t png = picture ? server.Picture() : 1;
    if (answer == 0 || png == 0) return state.SkipWithError("a request failed");
    bytes = answer;
  }
  state.counters["state_bytes"] = static_cast<double>(bytes);
}

void BM_ServeSetClick(benchmark::State& state) { Click(state, "/Set.1", false); }
void BM_ServeSetClickAndPicture(benchmark::State& state) { Click(state, "/Set.1", true); }
void BM_ServeDefaultOnlyClick(benchmark::State& state) { Click(state, "Default annotations only", false); }
void BM_ServeDefaultOnlyClickAndPicture(benchmark::State& state) { Click(state, "Default annotations only", true); }
}  // namespace

BENCHMARK(BM_ServeSetClick)->Arg(1000)->Arg(10000)->Unit(benchmark::kMillisecond)->UseRealTime();
BENCHMARK(BM_ServeSetClickAndPicture)->Arg(1000)->Arg(10000)->Unit(benchmark::kMillisecond)->UseRealTime();
BENCHMARK(BM_ServeDefaultOnlyClick)->Arg(1000)->Arg(10000)->Unit(benchmark::kMillisecond)->UseRealTime();
BENCHMARK(BM_ServeDefaultOnlyClickAndPicture)->Arg(1000)->Arg(10000)->Unit(benchmark::kMillisecond)->UseRealTime();
BENCHMARK_MAIN();
