#pragma once
// `qelhost --widgets [--json] [ROW...]`: a one-shot view of the panel's facet widgets over
// small facets made from the sample model, printed as a person sees it (or as JSON),
// then again after a click on each named row (for example "Annotation sets_Property1").
// It loads the plug-in and the preview library next to qelhost; the regular command line
// is not involved.

// True when the command line asks for the preview.
bool QelWidgetsPreviewWanted(int argc, char** argv);
// The program's exit status.
int QelWidgetsPreviewMain(int argc, char** argv);
