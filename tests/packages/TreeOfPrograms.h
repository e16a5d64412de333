// Scripts of the project, in a tree where other programs stand in the place of those that they start.
#pragma once

#include <gtest/gtest.h>

#include "tests/support/ShellCommand.h"
#include "tests/support/ShellProgram.h"

class TreeOfPrograms : public testing::Test
{
protected:
    void program(const std::string& name, const std::string& lines) const
    {
        writeProgram(folder, name, lines);
    }
    // One that only tells that it was started, and with which words.
    void tells(const std::string& name) const { program(name, "echo \"${0##*/} $*.\""); }

    // What makes a command find those in bin, and beside them the system's alone.
    std::string path() const { return "PATH='" + (folder / "bin").string() + "':/usr/bin:/bin "; }

    TemporaryFolder folder;
};
