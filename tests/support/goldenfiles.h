#pragma once
// Golden files: an expected output kept in tests/data, compared whole with what
// the program wrote (every line, the line count, the line ends and the
// encoding). Run the tests with QM_UPDATE_GOLDENS=1 to write the expected
// files afresh; read the changes before committing them.

#include <gtest/gtest.h>

#include <QString>

#include <string>

namespace qmtest {

// Compares two files' bytes whole, telling where and how they differ.
::testing::AssertionResult samebytes(const std::string& expected, const std::string& actual);

// Compares actual with the file tests/data/<relpath>, or writes it there when
// QM_UPDATE_GOLDENS is set.
::testing::AssertionResult matchesgolden(const QString& relpath, const std::string& actual);

} // namespace qmtest
