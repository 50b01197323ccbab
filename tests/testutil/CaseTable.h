#pragma once

#include <QTest>
#include <cstddef>

// Table-driven tests over a plain array of cases, each with a `name`: the _data function adds one
// row per case, and the test function fetches its row's case.
//
//   const struct { const char *name; const char *input, *expected; } Cases[] = {{"empty", "", ""}};
//   void parses_data() { addCaseRows(Cases); }
//   void parses() { const auto &c = fetchCase(Cases); QCOMPARE(parse(c.input), c.expected); }
namespace zorbin::test {

template <typename Case, std::size_t N> void addCaseRows(const Case (&cases)[N])
{
    QTest::addColumn<int>("caseIndex");
    for (std::size_t i = 0; i < N; ++i)
        QTest::newRow(cases[i].name) << int(i);
}

template <typename Case, std::size_t N> const Case &fetchCase(const Case (&cases)[N])
{
    QFETCH(int, caseIndex);
    return cases[caseIndex];
}

} // namespace zorbin::test
