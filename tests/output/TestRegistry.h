#pragma once

#include <QObject>
#include <functional>
#include <memory>
#include <vector>

// The test classes of this executable register themselves; main runs them in turn.
namespace zorbin::test {

using TestFactory = std::function<std::unique_ptr<QObject>()>;

inline std::vector<TestFactory> &registeredTests()
{
    static std::vector<TestFactory> tests;
    return tests;
}

template <typename T> bool registerTest()
{
    registeredTests().push_back([] { return std::make_unique<T>(); });
    return true;
}

} // namespace zorbin::test

#define ZORBIN_REGISTER_TEST(Class)                                                                          \
    namespace {                                                                                              \
    const bool registered##Class = zorbin::test::registerTest<Class>();                                      \
    }
