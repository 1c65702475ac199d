// A library that tests load by name: one function, and another one that it does not export.
extern "C" {

__attribute__((visibility("default"))) int answerOfPlugIn() {
    return 42;
}

int hiddenAnswerOfPlugIn() {
    return 43;
}
}
