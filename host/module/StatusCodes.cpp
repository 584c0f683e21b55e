#include "module/StatusCodes.h"

const std::vector<long>& KnownStatusCodes()
{
    static const std::vector<long> codes = []
    {
        std::vector<long> list = {0, -1};
        for (long code = -1002; code >= -1010; --code)
            list.push_back(code);
        for (long code = 1011; code <= 1015; ++code)
            list.push_back(code);
        for (long code = 1020; code <= 1032; ++code)
            list.push_back(code);
        return list;
    }();
    return codes;
}
