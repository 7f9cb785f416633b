// qelhost serve as the review page meets it: each test starts the real program on a free
// port with a placeholder page, talks to it over loopback and stops it with SIGTERM, which
// must end it cleanly.
#include <fcntl.h>
#include <gtest/gtest.h>
#include <httplib.h>
#include <netinet/in.h>
#include <poll.h>
#include <signal.h>
#include <sys/socket.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <chrono>
#include <filesystem>
#include <fstream>
#include <functional>
#include <nlohmann/json.hpp>
#include <optional>
#include <regex>
#include <set>
#include <sstream>
#include <thread>

namespace fs = std::filesystem;
using json = nlohmann::json;

namespace {
struct Size {
  int width, height;
};

std::optional<Size> PngSize(const std::string& png) {
  if (png.size() < 24 || png.compare(1, 3, "PNG") != 0) return std::nullopt;
  auto at = [&](size_t i) {
    return int(uint8_t(png[i])) << 24 | int(uint8_t(png[i + 1])) << 16 | int(uint8_t(png[i + 2])) << 8 |
           int(uint8_t(png[i + 3]));
  };
  return Size{at(16), at(20)};
}

void Walk(const json& node, const std::function<void(const json&, const std::vector<const json*>&)>& visit,
          std::vector<const json*>& path) {
  path.push_back(&node);
  visit(node, path);
  for (const json& child : node["children"]) Walk(child, visit, path);
  path.pop_back();
}

// The id of the visible part `part` in the panel row labelled `label`.
std::string PartOfRow(const json& panel, const std::string& label, const std::set<std::string>& parts) {
  std::string found;
  std::vector<const json*> path;
  Walk(panel, [&](const json& node, const std::vector<const json*>& ancestors) {
    if (!found.empty() || node["name"] != "PropertyLabel" || node["attributes"].value("text", "") != label) return;
    for (auto row = ancestors.rbegin(); row != ancestors.rend() && found.empty(); ++row) {
      std::vector<const json*> inner;
      Walk(**row, [&](const json& n, const std::vector<const json*>&) {
        if (found.empty() && parts.count(n["name"].get<std::string>()) && n["visible"] == true) found = n["id"];
      }, inner);
    }
  }, path);
  return found;
}

class QelHostServeTest : public ::testing::Test {
 protected:
  void SetUp() override {
    folder_ = fs::path(QEL_BINARY_DIR) / "web-server-test" / ::testing::UnitTest::GetInstance()->current_test_info()->name();
    fs::remove_all(folder_);
    // The host's catalogs and styles, and a placeholder where the page will be.
    const fs::path resources = folder_ / "resources";
    fs::create_directories(resources / "web");
    for (const char* part : {"catalogs", "styles"})
      fs::create_directory_symlink(fs::path(QEL_SOURCE_DIR) / "host" / "resources" / part, resources / part);
    std::ofstream(resources / "web" / "index.html") << "<!DOCTYPE html><head><title>review</title></head>\n";
    settings_ = folder_ / "settings";
    fs::create_directories(settings_);

    int out[2];
    ASSERT_EQ(pipe(out), 0);
    pid_ = fork();
    ASSERT_GE(pid_, 0);
    if (pid_ == 0) {
      dup2(out[1], STDOUT_FILENO);
      close(out[0]);
      close(out[1]);
      setenv("QEL_RESOURCES_DIR", resources.c_str(), 1);
      setenv("QEL_SETTINGS_DIR", settings_.c_str(), 1);
      execl(QEL_HOST_PROGRAM, QEL_HOST_PROGRAM, "serve", "--port", "0", static_cast<char*>(nullptr));
      _exit(127);
    }
    close(out[1]);
    out_ = out[0];
    const std::string line = ReadUntil("http://127.0.0.1:");
    std::smatch m;
    ASSERT_TRUE(std::regex_search(line, m, std::regex(R"(http://127\.0\.0\.1:(\d+)/\?token=([0-9a-f]{32}))"))) << line;
    port_ = std::stoi(m[1]);
    token_ = m[2];
    client_ = std::make_unique<httplib::Client>("127.0.0.1", port_);
  }

  void TearDown() override {
    if (pid_ <= 0) return;
    client_.reset();
    kill(pid_, SIGTERM);
    const std::string rest = ReadUntil("qelhost: stopped");
    // One that does not stop fails the test rather than hang it.
    if (rest.find("qelhost: stopped") == std::string::npos) kill(pid_, SIGKILL);
    int status = 0;
    waitpid(pid_, &status, 0);
    close(out_);
    EXPECT_NE(rest.find("qelhost: stopped"), std::string::npos) << rest;
    EXPECT_TRUE(WIFEXITED(status) && WEXITSTATUS(status) == 0) << "status " << status;
  }

  // Standard output up to the line holding `text` (or the end, after 20 s at most).
  std::string ReadUntil(const std::string& text) {
    std::string seen;
    char buffer[4096];
    for (int waited = 0; seen.find(text) == std::string::npos && waited < 200;) {
      pollfd fd{out_, POLLIN, 0};
      if (poll(&fd, 1, 100) <= 0) {
        ++waited;
        continue;
      }
      const ssize_t n = read(out_, buffer, sizeof buffer);
      if (n <= 0) break;
      seen.append(buffer, size_t(n));
    }
    return seen;
  }

  httplib::Headers Token() const { return {{"X-Qel-Token", token_}}; }
  httplib::Result Get(const std::string& path) { return client_->Get(path.c_str(), Token()); }
  httplib::Result Post(const std::string& path, const std::string& body) {
    return client_->Post(path.c_str(), Token(), body, "application/json");
  }
  json State() {
    auto res = Get("/api/state");
    EXPECT_TRUE(res && res->status == 200);
    return res ? json::parse(res->body) : json();
  }
  // Posts and expects a State back.
  json Send(const std::string& path, const json& body) {
    auto res = Post(path, body.dump());
    EXPECT_TRUE(res && res->status == 200) << path << " " << body << " -> " << (res ? res->body : "no answer");
    return res && res->status == 200 ? json::parse(res->body) : json();
  }
  json Click(const json& state, const std::string& label) {
    const std::string id = PartOfRow(state["panel"], label, {"CheckBox", "RadioButton"});
    EXPECT_FALSE(id.empty()) << "no row " << label;
    return Send("/api/event", {{"id", id}, {"type", "click"}});
  }
  std::string Picture() {
    auto res = Get("/api/picture.png");
    return res && res->status == 200 ? res->body : std::string();
  }

  fs::path folder_, settings_;
  pid_t pid_ = -1;
  int out_ = -1;
  int port_ = 0;
  std::string token_;
  std::unique_ptr<httplib::Client> client_;
};

TEST_F(QelHostServeTest, RefusesRequestsWithoutTheTokenOrFromAnotherHostName) {
  auto none = client_->Get("/api/state");
  ASSERT_TRUE(none);
  EXPECT_EQ(none->status, 403);
  EXPECT_EQ(std::count(none->body.begin(), none->body.end(), '\n'), 1) << none->body;
  EXPECT_EQ(client_->Get("/api/state", {{"X-Qel-Token", std::string(32, '0')}})->status, 403);
  // The query form of the token opens the page only.
  EXPECT_EQ(client_->Get(("/api/state?token=" + token_).c_str())->status, 403);
  // A page of another site whose name resolves here.
  EXPECT_EQ(client_->Get("/api/state", {{"X-Qel-Token", token_}, {"Host", "evil.example:" + std::to_string(port_)}})->status,
            403);
  EXPECT_EQ(client_->Get("/", {{"Host", "127.0.0.1:1"}})->status, 403);

  auto page = client_->Get(("/?token=" + token_).c_str());
  ASSERT_TRUE(page);
  EXPECT_EQ(page->status, 200);
  EXPECT_NE(page->body.find("<title>review</title>"), std::string::npos);
  EXPECT_EQ(page->get_header_value("Set-Cookie"), "qeltoken=" + token_ + "; Path=/; HttpOnly; SameSite=Strict");
  // Cookies ignore the port: an earlier server's cookie must not lock out the new address.
  EXPECT_EQ(client_->Get(("/?token=" + token_).c_str(), {{"Cookie", "qeltoken=" + std::string(32, 'f')}})->status, 200);
  EXPECT_EQ(client_->Get("/api/state", {{"Cookie", "other=1; qeltoken=" + token_}})->status, 200);
  EXPECT_EQ(client_->Get("/api/state", {{"Host", "localhost:" + std::to_string(port_)}, {"X-Qel-Token", token_}})->status,
            200);
}

TEST_F(QelHostServeTest, RefusesBadRequestsAndChangesNothing) {
  const json before = State();
  EXPECT_EQ(Post("/api/event", std::string(70000, ' '))->status, 413);
  EXPECT_EQ(Get("/api/event")->status, 405);
  const std::pair<std::string, std::string> bad[] = {
      {"/api/event", "{\"id\": \"0\", "},                                    // not JSON
      {"/api/event", "[1]"},                                                 // not an object
      {"/api/event", R"({"type": "click"})"},                                // no widget
      {"/api/event", R"({"id": "0.99.1", "type": "click"})"},                // unknown widget
      {"/api/event", R"({"id": "0", "type": "drag"})"},                      // unknown event
      {"/api/event", R"({"id": "0", "type": "click"})"},                     // the panel is no button
      {"/api/event", R"({"id": "0.0", "type": "select", "index": -1})"},
      {"/api/answer", R"({"answer": "yes"})"},                               // nothing asked
      {"/api/camera", R"({"zoom": 0})"},
      {"/api/camera", R"({"zoom": 2, "reframe": true})"},
      {"/api/activate", R"({"item": 999})"},
      {"/api/event", std::string(40, '[')},
  };
  for (const auto& [path, body] : bad) {
    auto res = Post(path, body);
    ASSERT_TRUE(res) << body;
    EXPECT_EQ(res->status, 400) << path << " " << body;
    const json error = json::parse(res->body, nullptr, false);
    EXPECT_TRUE(error.is_object() && error["error"].is_string() && !error["error"].get<std::string>().empty())
        << res->body;
  }
  const json after = State();
  EXPECT_EQ(after["display"], before["display"]);
  EXPECT_EQ(after["picture"], before["picture"]);
}

TEST_F(QelHostServeTest, ClickOnASetHidesItAndItsAnnotationsLeaveThePicture) {
  // A closed section's rows are not sent; opening it brings them.
  const json closed = State();
  EXPECT_TRUE(PartOfRow(closed["panel"], "Shaft_Rep/Shaft/Shaft Inspection", {"CheckBox"}).empty());
  std::string section;
  std::vector<const json*> at;
  Walk(closed["panel"], [&](const json& node, const std::vector<const json*>&) {
    if (node["name"] == "Selected sets_Expander") section = node["id"];
  }, at);
  const json before = Send("/api/event", {{"id", section}, {"type", "expand"}});
  const std::string picture = Picture();
  ASSERT_EQ(PngSize(picture).value_or(Size{}).width, 800);
  const json after = Click(before, "Shaft_Rep/Shaft/Shaft Inspection");
  EXPECT_EQ(after["changes"]["hidden"], json::array({"Shaft Inspection"}));
  EXPECT_EQ(after["changes"]["shown"], json::array());
  EXPECT_LT(after["display"]["shown"], before["display"]["shown"]);
  EXPECT_NE(after["picture"], before["picture"]);
  const std::string hidden = Picture();
  EXPECT_NE(hidden, picture);
  // The server draws the next picture before it is asked for; two changes in a row must not
  // leave the first one's picture to be sent for the second.
  Click(Click(after, "Shaft_Rep/Shaft/Shaft Inspection"), "Shaft_Rep/Shaft/Shaft Inspection");
  EXPECT_EQ(Picture(), hidden);
  // The rebuilt panel shows the row unticked.
  const std::string box = PartOfRow(after["panel"], "Shaft_Rep/Shaft/Shaft Inspection", {"CheckBox"});
  std::vector<const json*> path;
  int checked = -1;
  Walk(after["panel"], [&](const json& node, const std::vector<const json*>&) {
    if (node["id"] == box) checked = node["attributes"].value("checked", -1);
  }, path);
  EXPECT_EQ(checked, 0);

  // A range typed and chosen through the row's own parts, applied by its tick.
  const json filtered = [&] {
    const std::string editor = PartOfRow(after["panel"], "Tolerance value", {"LeftEditor"});
    const std::string combo = PartOfRow(after["panel"], "Tolerance value", {"LeftCombo"});
    EXPECT_FALSE(editor.empty() || combo.empty());
    Send("/api/event", {{"id", combo}, {"type", "select"}, {"index", 0}});
    Send("/api/event", {{"id", editor}, {"type", "text"}, {"text", "0.05"}});
    return Click(State(), "Tolerance value");
  }();
  EXPECT_FALSE(filtered["changes"]["hidden"].empty()) << filtered["changes"];
  EXPECT_LT(filtered["display"]["shown"], after["display"]["shown"]);
}

TEST_F(QelHostServeTest, AllSetsQuestionIsAnsweredThroughTheApi) {
  const json none = Click(State(), "No set");
  ASSERT_EQ(none["display"]["shown"], 0);

  // The question is refused while the request runs and kept for the person.
  json asked = Click(none, "All sets");
  ASSERT_TRUE(asked["question"].is_object());
  EXPECT_FALSE(asked["question"]["title"].get<std::string>().empty());
  EXPECT_EQ(asked["changes"]["shown"], json::array());
  const json no = Send("/api/answer", {{"answer", "no"}});
  EXPECT_TRUE(no["question"].is_null());
  EXPECT_EQ(no["changes"]["shown"], json::array());
  EXPECT_EQ(no["display"], none["display"]);
  EXPECT_EQ(Post("/api/answer", R"({"answer": "yes"})")->status, 400);

  // Any other request drops the question.
  ASSERT_TRUE(Click(no, "All sets")["question"].is_object());
  Send("/api/camera", {{"reframe", true}});
  EXPECT_EQ(Post("/api/answer", R"({"answer": "yes"})")->status, 400);

  ASSERT_TRUE(Click(State(), "All sets")["question"].is_object());
  const json yes = Send("/api/answer", {{"answer", "yes"}});
  EXPECT_TRUE(yes["question"].is_null());
  EXPECT_EQ(yes["changes"]["shown"].size(), 4u) << yes["changes"];
  EXPECT_GT(yes["display"]["shown"], 0);
}

TEST_F(QelHostServeTest, CameraCapturesAndThumbnailsChangeThePicture) {
  const json start = State();
  EXPECT_EQ(PngSize(Get("/api/picture.png?w=10&h=5000")->body).value_or(Size{}).height, 2048);
  const std::string picture = Picture();
  const json orbited = Send("/api/camera", {{"orbit", {30, 10}}});
  EXPECT_NE(orbited["picture"], start["picture"]);
  const std::string turned = Picture();
  EXPECT_NE(turned, picture);
  Send("/api/camera", {{"zoom", 2}});
  EXPECT_NE(Picture(), turned);

  // A light capture: its thumbnail, and its viewpoint when chosen.
  int capture = 0;
  for (const json& node : start["browser"]["nodes"])
    for (const json& item : node["items"])
      if (!capture && item["thumbnail"].is_string() && item["kind"] == "capture") capture = item["item"];
  ASSERT_GT(capture, 0) << start["browser"];
  auto thumbnail = Get("/api/thumbnail/" + std::to_string(capture) + ".png");
  ASSERT_TRUE(thumbnail && thumbnail->status == 200);
  EXPECT_EQ(PngSize(thumbnail->body).value_or(Size{}).width, 576);
  EXPECT_EQ(Get("/api/thumbnail/999.png")->status, 404);
  const std::string before = Picture();
  Send("/api/activate", {{"item", capture}});
  EXPECT_NE(Picture(), before);
}

TEST_F(QelHostServeTest, StopSavesTheSettings) {
  // TearDown stops the program; the panel's setting it switched on is then on disk.
  TearDown();
  pid_ = -1;
  std::ifstream file(settings_ / "QelRovDataFiltering.json");
  std::stringstream text;
  text << file.rdbuf();
  EXPECT_NE(text.str().find("DataFilteringPanel_LumReview"), std::string::npos) << text.str();
}
}  // namespace

namespace {
// A raw loopback connection to the server, for requests no HTTP client would send.
class RawConnection {
 public:
  explicit RawConnection(int port) {
    fd_ = socket(AF_INET, SOCK_STREAM, 0);
    sockaddr_in address{};
    address.sin_family = AF_INET;
    address.sin_port = htons(static_cast<uint16_t>(port));
    address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    if (connect(fd_, reinterpret_cast<sockaddr*>(&address), sizeof address) != 0) {
      close(fd_);
      fd_ = -1;
    }
  }
  ~RawConnection() {
    if (fd_ >= 0) close(fd_);
  }
  RawConnection(const RawConnection&) = delete;
  bool Open() const { return fd_ >= 0; }
  bool Send(const std::string& bytes) {
    return fd_ >= 0 && ::send(fd_, bytes.data(), bytes.size(), MSG_NOSIGNAL) == ssize_t(bytes.size());
  }
  // What the server sent until it closed, or until `seconds` passed.
  std::string Answer(int seconds) {
    std::string answer;
    char buffer[4096];
    const auto end = std::chrono::steady_clock::now() + std::chrono::seconds(seconds);
    while (std::chrono::steady_clock::now() < end) {
      pollfd fd{fd_, POLLIN, 0};
      if (poll(&fd, 1, 50) <= 0) continue;
      const ssize_t n = recv(fd_, buffer, sizeof buffer, 0);
      if (n <= 0) break;
      answer.append(buffer, size_t(n));
    }
    return answer;
  }

 private:
  int fd_ = -1;
};

long ResidentKilobytes(pid_t pid) {
  std::ifstream status("/proc/" + std::to_string(pid) + "/status");
  for (std::string line; std::getline(status, line);)
    if (line.rfind("VmRSS:", 0) == 0) return std::stol(line.substr(6));
  return -1;
}
}  // namespace

TEST_F(QelHostServeTest, ChangesNeedTheTokenHeaderAndTheServersOwnOrigin) {
  const std::string event = R"({"id": "0", "type": "click"})";
  const std::string cookie = "qeltoken=" + token_;
  const std::string own = "http://127.0.0.1:" + std::to_string(port_);
  // A form of another page of this machine carries the cookie, never the header.
  auto forged = client_->Post("/api/event", {{"Cookie", cookie}}, event, "text/plain");
  ASSERT_TRUE(forged);
  EXPECT_EQ(forged->status, 403) << forged->body;
  EXPECT_NE(forged->body.find("X-Qel-Token"), std::string::npos) << forged->body;
  for (const std::string& origin : std::vector<std::string>{"null", "http://127.0.0.1:1", "http://evil.example",
                                                            own + ".evil.example"}) {
    auto res = client_->Post("/api/event", {{"X-Qel-Token", token_}, {"Origin", origin}}, event, "application/json");
    ASSERT_TRUE(res);
    EXPECT_EQ(res->status, 403) << origin;
  }
  EXPECT_EQ(client_->Get("/api/state", {{"Cookie", cookie}, {"Origin", "null"}})->status, 403);
  // The page itself: its own origin and the header.
  EXPECT_EQ(client_->Post("/api/event", {{"X-Qel-Token", token_}, {"Origin", own}}, event, "application/json")->status,
            400) << "admitted, and refused only for what it asks";
  EXPECT_EQ(client_->Get("/api/state", {{"Cookie", cookie}, {"Origin", own}})->status, 200);
  // Reads still take the cookie, whichever of two comes first.
  EXPECT_EQ(client_->Get("/api/state", {{"Cookie", "qeltoken=" + std::string(32, 'f') + "; " + cookie}})->status, 200);
  EXPECT_EQ(client_->Get("/api/state", {{"Cookie", "qeltoken=" + std::string(32, 'f') + "; qeltoken=1"}})->status, 403);
  // A reloaded page has lost the token from its address: the page carries it.
  auto page = client_->Get("/", {{"Cookie", cookie}});
  ASSERT_TRUE(page && page->status == 200);
  EXPECT_NE(page->body.find("qel-token\" content=\"" + token_), std::string::npos) << page->body;
}

TEST_F(QelHostServeTest, BodiesOverTheLimitAreRefusedBeforeTheyAreRead) {
  const long residentBefore = ResidentKilobytes(pid_);
  const std::string head = "POST /api/event HTTP/1.1\r\nHost: 127.0.0.1:" + std::to_string(port_) +
                           "\r\nX-Qel-Token: " + token_ + "\r\nContent-Type: application/json\r\n";
  {
    // The stated length alone is enough: the answer comes with none of the body sent.
    RawConnection stated(port_);
    ASSERT_TRUE(stated.Send(head + "Content-Length: 201326592\r\n\r\n"));
    const std::string answer = stated.Answer(5);
    EXPECT_EQ(answer.rfind("HTTP/1.1 413", 0), 0u) << answer;
  }
  {
    // A chunked body states no length: it is counted as it comes and cut at the limit.
    RawConnection chunked(port_);
    ASSERT_TRUE(chunked.Send(head + "Transfer-Encoding: chunked\r\n\r\n"));
    const std::string chunk = "10000\r\n" + std::string(0x10000, ' ') + "\r\n";
    int sent = 0;
    while (sent < 1600 && chunked.Send(chunk)) ++sent;  // up to 100 MB, until the server closes
    const std::string answer = chunked.Answer(5);
    EXPECT_LT(sent, 1600) << "the server read on past the limit";
    if (!answer.empty()) {
      EXPECT_EQ(answer.rfind("HTTP/1.1 413", 0), 0u) << answer.substr(0, 200);
    }
  }
  EXPECT_LT(ResidentKilobytes(pid_) - residentBefore, 16 * 1024) << "no body was kept";
  EXPECT_EQ(State()["display"]["shown"].is_number(), true) << "the server still answers";
}

TEST_F(QelHostServeTest, IdleAndTricklingConnectionsDoNotStarveThePage) {
  // Each of these holds a connection with half a request, as a slow or hostile client does.
  // They connect from several threads, so that the listen queue's retries overlap.
  std::vector<std::unique_ptr<RawConnection>> slow(200);
  std::vector<std::thread> openers;
  for (int t = 0; t < 10; ++t)
    openers.emplace_back([&, t] {
      for (int i = t; i < 200; i += 10) {
        slow[i] = std::make_unique<RawConnection>(port_);
        if (i % 2) slow[i]->Send("GET /api/state HTTP/1.1\r\nHo");
      }
    });
  for (std::thread& opener : openers) opener.join();
  for (const auto& connection : slow) ASSERT_TRUE(connection->Open());
  // A fixed pool of workers all waiting on these would leave the page unanswered for the
  // read timeout of each round of them: minutes.
  const auto start = std::chrono::steady_clock::now();
  httplib::Client page("127.0.0.1", port_);
  page.set_read_timeout(20, 0);
  auto res = page.Get("/api/state", Token());
  const auto waited = std::chrono::steady_clock::now() - start;
  ASSERT_TRUE(res);
  EXPECT_EQ(res->status, 200);
  EXPECT_LT(waited, std::chrono::seconds(4));
  for (auto& connection : slow) connection->Send("st");  // still trickling
}
