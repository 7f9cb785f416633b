#pragma once
// QelHostWebApi: the review page's API on an open session, plain text in and out, so it
// runs without sockets. Every call must come from the UI thread (the session's objects are
// counted and single-threaded). Made after the session has opened its model, it keeps the
// views browser open and a question asker installed; both go with it, before the session.
#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "QelCallbackManager.h"
#include "QelDlgNotify.h"
#include "QelHostWebRequest.h"
#include "QelVar.h"

class QelDbrBrowser;
class QelHostSession;

// With its parameter, so the HTTP library does not compress the answer: its brotli
// compression at full quality takes seconds on a large panel, far more than loopback saves.
inline constexpr const char* kQelJsonType = "application/json; charset=utf-8";

struct QelHostWebReply {
  int status = 200;
  std::string contentType = kQelJsonType;
  std::string body;
};

class QelVidWidget;

class QelHostWebApi {
 public:
  explicit QelHostWebApi(QelHostSession& session);
  ~QelHostWebApi();
  QelHostWebApi(const QelHostWebApi&) = delete;
  QelHostWebApi& operator=(const QelHostWebApi&) = delete;

  QelHostWebReply State();
  QelHostWebReply Event(std::string_view body);
  QelHostWebReply Answer(std::string_view body);
  QelHostWebReply Camera(std::string_view body);
  QelHostWebReply Activate(std::string_view body);
  // Clicks the panel back to how it read when the model opened (body: {} ).
  QelHostWebReply Reset(std::string_view body);
  // Makes a product UI-active, as a click in the product tree does (body: {"product": N},
  // N from the State's "products"); the views browser follows it.
  QelHostWebReply UiActive(std::string_view body);
  // Switches the panel on again in the current workbench, saved, and shows it (body: {}).
  QelHostWebReply OpenPanel(std::string_view body);
  // The 3D viewer's picture as PNG; the size is clamped to 64..2048.
  QelHostWebReply Picture(int width, int height);
  QelHostWebReply Thumbnail(int item);

  // Grows whenever the picture would change.
  int PictureVersion() const { return version_; }
  // Draws the picture a change made stale, at the size last asked for, so that it is ready
  // when the page asks; called while no request waits. Only for a client that fetched the
  // picture drawn before: one that never asks for pictures costs at most one. True when drawn.
  bool PreparePicture();

 private:
  struct Changes {
    std::vector<std::string> shown, hidden;
  };
  struct Question {
    std::string title, message;
  };

  void BeginChanges();
  Changes EndChanges();
  // Runs the event on its widget, recording what it changed; false with `error` when the
  // event names no widget that takes it.
  bool Run(const QelHostWebEvent& event, Changes& changes, std::string& error);
  bool Dispatch(const QelHostWebEvent& event, std::string& error);
  // Why a range entry or a range's tick cannot apply, with the box it is about in
  // `errorAt_`; empty when it can.
  std::string RangeRefusal(QelVidWidget* panel, QelVidWidget* widget, const QelHostWebEvent& event);
  std::string ProductsJson();
  QelHostWebReply StateWith(const Changes& changes);
  std::string BrowserJson();
  // Draws and encodes the picture for the current version; the reason when it cannot.
  std::string DrawPicture(int width, int height);
  int ItemId(QelBaseUnknown* item);

  QelHostSession& session_;
  QelVar<QelDbrBrowser> browser_;
  std::vector<QelBaseUnknown_var> items_;  // item id - 1
  std::map<QelBaseUnknown*, int> itemIds_;
  std::map<int, std::string> thumbnails_;  // PNG bytes by item id
  // The annotations of every set, for the display counts.
  std::vector<std::pair<QelBaseUnknown_var, std::vector<QelBaseUnknown_var>>> annotationsBySet_;

  QelCallbackId displayCallback_ = 0;
  bool recording_ = false;
  std::vector<QelBaseUnknown_var> changed_;
  std::map<QelBaseUnknown*, bool> shownBefore_;

  QelDlgNotify::Asker previousAsker_;
  std::optional<Question> asked_;     // by the module during the current event
  std::optional<Question> question_;  // waiting for the person
  std::optional<QelHostWebEvent> pending_;

  int version_ = 1;
  int pictureVersion_ = 0, pictureWidth_ = 0, pictureHeight_ = 0;
  int servedVersion_ = 0;    // of the picture last sent
  int preparedVersion_ = 0;  // the last version PreparePicture tried
  std::string picture_;
  std::vector<std::string> unplaced_;  // labels the last picture could not place
  std::string errorAt_;  // the widget id a refusal is about, for the page to mark
  std::vector<QelBaseUnknown_var> products_;  // in the model's order, for "products"
  std::string activatedCapture_;
};
