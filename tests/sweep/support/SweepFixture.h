// SPDX-FileCopyrightText: 2026 The Tarrow Drive authors
// SPDX-License-Identifier: GPL-3.0-or-later

#pragma once

#include "host/drive/records/DriveLayout.h"
#include "tests/support/TemporaryDirectory.h"
#include "tests/sweep/support/FaultyRun.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <iosfwd>
#include <map>
#include <string>
#include <vector>

namespace sweep_tests {

/// Says whether documents can be renamed between all folders or some lie on another file system.
enum class FileSystems { One, Several };

struct Operation {
    const char* name;
    std::vector<std::string> arguments;
    FileSystems fileSystems = FileSystems::One;
};

void PrintTo(const Operation& operation, std::ostream* stream);

/// Answers all operations that change the drive.
std::vector<Operation> operations();

/// The drive as a user sees it: every item by its path, a document with its content, a promise with the
/// content behind it, also what is in a package that is promised.
using Drive = std::map<std::string, std::string>;

/// A small drive with every kind of item, on which an operation runs.
class SweepFixture : public testing::TestWithParam<Operation> {
protected:
    SweepFixture() { ::setenv("TARROW_DRIVE_HOME", _layout.home().c_str(), 1); }
    ~SweepFixture() override { ::unsetenv("TARROW_DRIVE_HOME"); }

    void makeDrive() const;
    std::string at(const std::string& path) const { return _layout.defaultContainer() + '/' + path; }
    /// Answers the path of a document in the app library of the drive.
    std::string libraryDocument() const;

    /// Runs the operation and lets its calls meet faults.
    Ending run(const FaultFor& faultFor = [](const FileCall&) { return Fault{}; }) const;
    using IsPossible = std::function<bool(const FileCall&)>;
    /// Says whether each call has its turn, or in ./test about fifty of more and each that changes names;
    /// the long run takes all.
    enum class Turns { All, Some };
    /// Runs the operation on a new drive for each of its calls in turn, or those for which the fault is
    /// possible. The call meets the fault, and it is checked afterwards. The check is told of call 0 when the
    /// operation ended without that call.
    void atEachCall(
        const FaultFor& faultFor, const std::function<void(const FileCall& met, const Ending& ending)>& check,
        const IsPossible& isPossible = [](const FileCall&) { return true; }, Turns turns = Turns::All) const;
    /// Does what every program does when it starts on the drive.
    void startAgain() const;

    /// Answers whether the operation removes an item or a document's content.
    bool isRemoval() const;
    Drive seen() const;
    /// Answers the drive without promises that add nothing to the document that hides them.
    Drive noticed() const;
    /// Answers the files that should not exist when no program works on the drive.
    std::vector<std::string> leftovers() const;
    /// Answers whether every content of a drive exists somewhere, under any name.
    bool isAllThere(const Drive& drive) const;
    /// Answers whether no name shows a content that was not under some name before.
    static bool isNothingHalf(const Drive& now, const Drive& before);
    /// Answers whether an operation that was ended on the way, and what the next start makes of it, may leave
    /// this drive: the one before or the one after, or some of the folders that were being made.
    bool isBeforeOrAfter(const Drive& now, const Drive& before, const Drive& after) const;
    /// Answers the same, but where documents are copied to another file system a second misfortune may leave
    /// both.
    bool isBeforeAfterOrBoth(const Drive& now, const Drive& before, const Drive& after) const;
    static std::string differences(const Drive& now, const Drive& before);
    static std::string read(const std::string& path);
    static void write(const std::string& path, const std::string& content);

    const testing_support::TemporaryDirectory _folder;
    const host::drive::DriveLayout _layout = host::drive::DriveLayout::at(_folder.at("drive")).prepare();

private:
    /// Answers the indexes of the calls that have their turn.
    std::vector<int> points(const IsPossible& isPossible, Turns turns) const;
    static void addMarks(Drive& drive, const std::string& shown, const std::vector<std::string>& tags,
        std::uint32_t identifier);
    void addItems(Drive& drive, const std::string& folder, const std::string& prefix) const;
    /// Answers the places in the trash with an item and a record.
    std::vector<std::string> trashPlaces() const;
    bool isForOtherFileSystem(const FileCall& call) const;
    void promise(const std::string& path, const std::string& content) const;
    void addPromised(Drive& drive, const std::string& shown, const std::string& promisePath) const;
    static void writePackage(const std::string& path, const std::string& text);
    void promisePackage() const;
    /// Answers the path of the content that a promise names; empty when there is none.
    std::string contentBehind(const std::string& promisePath) const;
};

} // namespace sweep_tests
