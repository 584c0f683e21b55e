#pragma once
// Turns the leading bytes of a fuzz input into conversion parameters. Most
// numbers come out as everyday page sizes so the layout code is reached;
// some are the extremes a typed-in setting can produce (0, huge, NaN, inf).
#include <cstddef>
#include <cstdint>
#include <limits>
#include <string>

#include "EPStoPSparams.h"

namespace fuzzsupport
{
class ParameterBytes
{
public:
    ParameterBytes(const uint8_t* data, size_t size) : m_data(data), m_size(size) {}

    uint8_t Byte() { return m_offset < m_size ? m_data[m_offset++] : 0; }

    // Little-endian, low byte first (two statements: operand order is unspecified).
    uint16_t Word()
    {
        const uint16_t low = Byte();
        return static_cast<uint16_t>(low | Byte() << 8);
    }

    double Length()
    {
        const uint8_t kind = Byte();
        const auto raw = static_cast<int16_t>(Word());
        switch (kind % 8)
        {
        case 5:
            return 0.0;
        case 6:
            return raw < 0 ? -1e300 : 1e300;
        case 7:
            return raw == 0  ? std::numeric_limits<double>::quiet_NaN()
                   : raw > 0 ? std::numeric_limits<double>::infinity()
                             : -std::numeric_limits<double>::infinity();
        default:
            return raw / 4.0; // quarter points up to about 8000 pt either way
        }
    }

    // The parameters, with setPageDeviceString pointing into command.
    EPStoPSparams_t Parameters(std::string& command)
    {
        EPStoPSparams_t params{};
        params.imageWidth = Length();
        params.imageHeight = Length();
        params.pageWidth = Length();
        params.pageHeight = Length();
        params.imageableLLX = Length();
        params.imageableLLY = Length();
        params.imageableURX = Length();
        params.imageableURY = Length();
        params.imagePosition = Byte() % 7; // 5 and 6: no offset
        const uint16_t flags = Word();
        bool* switches[] = {&params.shrinkToFit,
                            &params.fitToPage,
                            &params.scaleToPrintable,
                            &params.autoRotate,
                            &params.constrainProportions,
                            &params.widthGiven,
                            &params.heightGiven,
                            &params.customSize,
                            &params.autoScale};
        for (size_t i = 0; i < sizeof switches / sizeof switches[0]; ++i)
            *switches[i] = (flags >> i) & 1;
        const uint8_t length = Byte();
        command.clear();
        while (command.size() < length && m_offset < m_size)
            command.push_back(static_cast<char>(Byte()));
        params.setPageDeviceString = (flags & 0x8000) ? nullptr : command.data();
        return params;
    }

    // Where the parameter bytes end and the file content starts.
    size_t Consumed() const { return m_offset < m_size ? m_offset : m_size; }

private:
    const uint8_t* m_data;
    size_t m_size;
    size_t m_offset = 0;
};
} // namespace fuzzsupport
