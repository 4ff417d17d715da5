#include "sim/errorqueue.h"

#include <array>

namespace kdx::sim {

namespace {

struct ErrorRow {
    ScpiError error;
    std::string_view text;
};

constexpr std::array kErrors = {
    ErrorRow{ScpiError::None, "No error"},
    ErrorRow{ScpiError::InvalidSeparator, "Invalid separator"},
    ErrorRow{ScpiError::ParameterNotAllowed, "Parameter not allowed"},
    ErrorRow{ScpiError::MissingParameter, "Missing parameter"},
    ErrorRow{ScpiError::UndefinedHeader, "Undefined header"},
    ErrorRow{ScpiError::InvalidSuffix, "Invalid suffix"},
    ErrorRow{ScpiError::InvalidString, "Invalid string data"},
    ErrorRow{ScpiError::SettingsConflict, "Settings conflict"},
    ErrorRow{ScpiError::OutOfRange, "Data out of range"},
    ErrorRow{ScpiError::TooMuchData, "Too much data"},
    ErrorRow{ScpiError::IllegalValue, "Illegal parameter value"},
    ErrorRow{ScpiError::QueueOverflow, "Queue overflow"},
    ErrorRow{ScpiError::InputBufferOverrun, "Input buffer overrun"},
    ErrorRow{ScpiError::QueryInterrupted, "Query INTERRUPTED"},
    ErrorRow{ScpiError::QueryUnterminated, "Query UNTERMINATED"},
    ErrorRow{ScpiError::QueryDeadlocked, "Query DEADLOCKED"},
};

}  // namespace

std::string_view errorText(ScpiError error) {
    for (const ErrorRow& row : kErrors) {
        if (row.error == error) return row.text;
    }
    return "Unknown error";
}

std::string errorAnswer(ScpiError error) {
    return std::to_string(static_cast<int>(error)).append(",\"").append(errorText(error)).append("\"");
}

void ErrorQueue::push(ScpiError error) {
    if (m_errors.size() < kCapacity) {
        m_errors.push_back(error);
    } else {
        m_errors.back() = ScpiError::QueueOverflow;
    }
}

std::string ErrorQueue::pop() {
    ScpiError error = ScpiError::None;
    if (!m_errors.empty()) {
        error = m_errors.front();
        m_errors.pop_front();
    }
    return errorAnswer(error);
}

}  // namespace kdx::sim
