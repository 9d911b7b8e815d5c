#pragma once

#include <string>

namespace dxftest {
// dxf_check.py run on the file (in test_dxf_writer.cpp): 0 when ezdxf audits it without error and agrees
// with everything expected; `report` receives what it said.
int CheckWithEzdxf(const std::string& file, const std::string& arguments, std::string& report);
} // namespace dxftest
