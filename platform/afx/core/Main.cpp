#include "platform/afx/core/App.h"

int main(int argc, char** argv) {
    return AfxWinMain(argc, argv);
}
