#include "platform/kernel.h"
#include "saver/saver_main.h"

int main(int count, char** arguments) {
    SetCommandLineArguments(count, arguments);
    return ProcessStart();
}
