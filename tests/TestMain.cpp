// The main of the model tests.
#include "support/PrivateTempDir.h"

#include <gtest/gtest.h>

int main(int argc, char** argv) {
    testsupport::PrivateTempDir temp;
    ::testing::InitGoogleTest(&argc, argv);
    return RUN_ALL_TESTS();
}
