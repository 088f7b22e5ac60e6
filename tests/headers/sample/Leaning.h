#pragma once

extern std::vector<int> leaning_on_its_includer;
