#pragma once

#include <QString>
#include <optional>
#include <utility>

namespace zorbin {

// The outcome of an operation that can fail in a way the user must hear about.
// A failure carries the description shown to the user as it stands (the fault box shows it
// verbatim), so it is written in the words of whoever detected the failure.
class [[nodiscard]] Status
{
public:
    Status() = default; // success

    static Status ok() { return {}; }
    static Status fault(QString description) { return Status(std::move(description)); }

    bool isOk() const { return !m_failed; }
    explicit operator bool() const { return isOk(); }
    const QString &description() const { return m_description; }

private:
    explicit Status(QString description) : m_description(std::move(description)), m_failed(true) {}

    QString m_description;
    bool m_failed = false;
};

// A value, or the Status that explains why there is none.
template <typename T> class [[nodiscard]] Result
{
public:
    Result(T value) : m_value(std::move(value)) {}
    Result(Status failure) : m_status(std::move(failure)) { Q_ASSERT(!m_status.isOk()); }

    bool isOk() const { return m_value.has_value(); }
    explicit operator bool() const { return isOk(); }
    const Status &status() const { return m_status; }

    T &value() &
    {
        Q_ASSERT(isOk());
        return *m_value;
    }
    const T &value() const &
    {
        Q_ASSERT(isOk());
        return *m_value;
    }
    T &&value() &&
    {
        Q_ASSERT(isOk());
        return std::move(*m_value);
    }
    T *operator->() { return &value(); }
    const T *operator->() const { return &value(); }

private:
    std::optional<T> m_value;
    Status m_status;
};

} // namespace zorbin
