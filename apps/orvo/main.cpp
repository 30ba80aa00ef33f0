#include "Classes.h"
#include "orvo/Program.h"

#include <exception>
#include <iostream>
#include <sys/stat.h>

int main(int argc, char** argv) {
    // What is kept is the person's own: where they live, which lines they ride.
    umask(S_IRWXG | S_IRWXO);
    orvo::CodingClassTable::current().set(orvo::codingClasses());
    const orvo::Terminal terminal = orvo::Terminal::standard();
    try {
        orvo::Program program(terminal);
        const auto code = program.run(std::vector<std::string>(argv + 1, argv + argc));
        std::cout.flush();
        if (std::cout)
            return static_cast<int>(code);
        terminal.error("the output cannot be written");
    } catch (const std::exception& error) {
        terminal.error(error.what());
    }
    return static_cast<int>(orvo::ExitCode::Failed);
}
