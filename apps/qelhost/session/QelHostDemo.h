#pragma once
// The review `qelhost --demo` runs on the sample: the panel as it opens, a few ticks with
// what each hid or showed, a tolerance range, and the panel as it ends up.
inline constexpr const char* kQelHostDemoScript = R"(panel
tick "Annotation Sets/Root product sets"
untick "Annotation Types/By kind/Datums"
tick "Annotation Types/Default annotations only"
range "Annotation Types/Tolerance value" <= 0.05 <= 0.2
answer yes
tick "Annotation Sets/All sets"
panel
)";
