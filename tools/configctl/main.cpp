// configctl: the administrators' command-line tool for a configuration service.
#include <ace/Log_Msg.h>

#include <iostream>
#include <string>

#include "Commands.h"
#include "ExitStatus.h"
#include "ToolOptions.h"

int main(int argc, char** argv) {
    // The library logs its failures at debug level; the tool reports them in one line instead.
    ACE_LOG_MSG->priority_mask(LM_ERROR | LM_CRITICAL | LM_ALERT | LM_EMERGENCY,
                               ACE_Log_Msg::PROCESS);
    try {
        const Configctl::ToolOptions options =
            Configctl::ToolOptions::parse(std::vector<std::string>(argv + 1, argv + argc));
        if (options.help) {
            std::cout << Configctl::ToolOptions::usage();
            return 0;
        }
        if (options.version) {
            std::cout << "configctl " << CONFIGCTL_VERSION << "\n";
            return 0;
        }
        Configctl::Commands(options, std::cout).run();
        return 0;
    } catch (const std::exception& e) {
        std::string message = e.what();
        while (!message.empty() && (message.back() == '\n' || message.back() == '\r')) {
            message.pop_back();
        }
        for (char& c : message) {
            if (c == '\n' || c == '\r') {
                c = ' ';
            }
        }
        std::cout.flush();
        std::cerr << "configctl: " << message << "\n";
        return Configctl::exitStatusFor(e);
    }
}
