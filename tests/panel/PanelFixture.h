#pragma once
// A review host for the panel's tests: settings in a folder of their own, the frame in
// "LumReview", a model with two parts and a set each, its editor with the root UI-active
// and a current 3D window with a viewer. The process-wide controller is released after
// each test, as the module's unload does, and the delayed destructions are done.
#include <gtest/gtest.h>

#include <string>

#include "Qel3DWindow.h"
#include "QelFrmEditor.h"
#include "QelFrmLayout.h"
#include "QelRovFacetController.h"
#include "QelSettingRepository.h"

class PanelFixture : public ::testing::Test {
 protected:
  void SetUp() override;
  void TearDown() override;

  // A new editor over the model, its root UI-active (or nothing, with `active` false).
  QelVar<QelFrmEditor> OpenEditor(bool active = true);
  // A window of kind W for `editor`, added to the layout and made current; 3D windows
  // get a viewer.
  template <class W>
  QelVar<W> OpenWindow(QelFrmEditor* editor) {
    auto window = QelMakeVar<W>(editor);
    if constexpr (std::is_same_v<W, Qel3DWindow>) window->SetViewer(NewViewer().get());
    layout->AddWindow(window.get());
    layout->SetCurrentWindow(window.get());
    return window;
  }
  QelBaseUnknown_var NewViewer();
  // The controller, made through the component dictionary as the host does.
  QelRovFacetController* Controller();
  // Writes the key of `workbench` (with its notification unless `silent`).
  void WriteSetting(const char* workbench, int value, bool silent = false);

  std::string folder;
  QelSettingRepository* repository = nullptr;
  QelFrmLayout* layout = nullptr;
  QelBaseUnknown_var root;
  QelBaseUnknown_var partA;
  QelBaseUnknown_var setA;
  QelVar<QelFrmEditor> editor;
  QelVar<Qel3DWindow> window;
  QelBaseUnknown_var controller;
};
