#pragma once
// QelVidCtl: a widget that takes its look from a style sheet. SetCustomStyle instantiates
// the style's template (a tree of named parts) under the control, binds introspectable
// properties to part attributes, routes part events to the control's named handlers and
// calls OnTemplateApplied before it returns. A sheet or style that cannot be used is
// reported (file, style and place) and leaves the control without parts.
#include <memory>
#include <string>
#include <vector>

#include "QelSYPMetaClass.h"
#include "QelVidWidget.h"

class QelVidCtl : public QelVidWidget {
 public:
  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;

  QelVidCtl(QelVidWidget* parent, QelString name);
  const char* GetWidgetKind() const override { return "Control"; }
  QelString GetResourceFilename(int level) const override;

  // S_OK once the template is in place; E_FAIL after a reported refusal. `variant` is
  // reserved by the toolkit and must be empty.
  HRESULT SetCustomStyle(const QelString& sheet, const QelString& style, const QelString& variant);
  const QelString& GetStyleName() const;

  // The part of the applied template with that name, or null.
  QelVidWidget* RetrieveSypNamedObject(const QelString& name) const;

  // Re-reads the bound properties into the parts: all of them for "", else those bound
  // to `propertyName`.
  void DispatchModifyProperty(const char* propertyName) override;

  // What the style sheet keeps of a template for the controls it styles: the parts are
  // numbered in the order they are made, and names and bindings refer to those numbers.
  // Shared by every control of one style, so a control holds only its parts.
  struct TemplateIndex {
    struct NamedPart {
      std::string name;
      size_t part;
    };
    struct Binding {
      size_t part;
      const std::string* attribute;  // from QelVidAttributeName
      const QelSYPMetaClass::Property* property;  // owned by the class's table
    };
    QelString style;  // the style the template came from
    size_t partCount = 0;
    std::vector<NamedPart> namedParts;
    std::vector<Binding> bindings;  // in the order they are read
  };
  // The index of the applied template (null without one) and its part of that number.
  const TemplateIndex* GetTemplateIndex() const { return index_.get(); }
  QelVidWidget* GetTemplatePart(size_t number) const { return number < parts_.size() ? parts_[number].get() : nullptr; }
  // Used by the style sheet once a template is instantiated: `parts` in the index's order.
  void SetTemplate(QelVidWidget* root, std::shared_ptr<const TemplateIndex> index,
                   std::vector<QelVar<QelVidWidget>> parts);

 protected:
  ~QelVidCtl() override;
  // Called by SetCustomStyle once the parts exist, bindings and routes included.
  virtual void OnTemplateApplied() {}

 private:
  void ClearTemplate();

  std::shared_ptr<const TemplateIndex> index_;
  std::vector<QelVar<QelVidWidget>> parts_;
  QelVar<QelVidWidget> templateRoot_;
};
