#include "store/files/inspectFile.h"

#include <iostream>

/// inspectFiles FILE...: what is in each of them, as for a picture of 400 x 300; one JSON object a line.
int main(int count, char **arguments)
{
    for (int i = 1; i < count; ++i)
        std::cout << Project::InspectionJson(Project::InspectFile(arguments[i], Project::PImageSize{400, 300})) << '\n';
}
