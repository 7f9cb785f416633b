#include "QelVidCtl.h"

#include "QelVidStyleSheet.h"

const QelMetaObject& QelVidCtl::MetaObject() {
  static const QelMetaObject& meta =
      QelMetaObject::Declare("QelVidCtl", QelMetaKind::Implementation, &QelVidWidget::MetaObject(), "toolkit");
  return meta;
}
const QelMetaObject* QelVidCtl::GetMetaObject() const { return &MetaObject(); }

QelVidCtl::QelVidCtl(QelVidWidget* parent, const QelString& name) : QelVidWidget(parent, name) {}

QelVidCtl::~QelVidCtl() = default;

QelString QelVidCtl::GetResourceFilename(int level) const {
  if (level <= 0) return QelString("QelVidCtl");
  return QelVidWidget::GetResourceFilename(level - 1);
}

HRESULT QelVidCtl::SetCustomStyle(const QelString& sheet, const QelString& style, const QelString& variant) {
  ClearTemplate();
  if (!variant.IsEmpty()) {
    QelVidStyleSheet::Report("style sheet " + sheet.Str() + ", style " + style.Str() + ": variant \"" + variant.Str() +
                             "\" is not supported (it must be empty)");
    return E_FAIL;
  }
  const QelVidStyleSheet* loaded = QelVidStyleSheet::Load(sheet.Str(), style.Str());
  if (!loaded) return E_FAIL;
  if (QelFailed(loaded->Instantiate(this, style.Str()))) return E_FAIL;
  style_ = style;
  OnTemplateApplied();
  DispatchModifyProperty("");
  return S_OK;
}

QelVidWidget* QelVidCtl::RetrieveSypNamedObject(const QelString& name) const {
  for (const auto& [partName, part] : parts_)
    if (partName == name.Str()) return part.get();
  return nullptr;
}

void QelVidCtl::DispatchModifyProperty(const char* propertyName) {
  const bool all = !propertyName || !*propertyName;
  for (const Binding& binding : bindings_) {
    if (!all && binding.property->name != propertyName) continue;
    QelSYPValue value;
    if (QelSYPMetaClass::Read(this, *binding.property, value)) binding.part->SetAttribute(binding.attribute, value);
  }
}

void QelVidCtl::SetTemplateRoot(QelVidWidget* root) {
  if (!root) return;
  templateRoot_ = QelVar<QelVidWidget>::Retain(root);
  AddChild(root);
}

void QelVidCtl::ReserveTemplate(size_t namedParts, size_t bindings) {
  parts_.reserve(parts_.size() + namedParts);
  bindings_.reserve(bindings_.size() + bindings);
}

void QelVidCtl::AddNamedPart(const std::string& name, QelVidWidget* part) {
  if (parts_.empty()) parts_.reserve(8);
  if (part) parts_.emplace_back(name, QelVar<QelVidWidget>::Retain(part));
}

void QelVidCtl::AddBinding(QelVidWidget* part, const std::string& attribute,
                           const QelSYPMetaClass::Property* property) {
  if (bindings_.empty()) bindings_.reserve(8);
  if (part && property) bindings_.push_back({QelVar<QelVidWidget>::Retain(part), attribute, property});
}

void QelVidCtl::ClearTemplate() {
  bindings_.clear();
  parts_.clear();
  if (templateRoot_) RemoveChild(templateRoot_.get());
  templateRoot_ = nullptr;
  style_ = QelString();
}
