#include <VelaMediaLib/VelaMediaLib.h>

#include <iostream>

int main() {
    const VelaMediaLib::SafeRational frame(1001, 30000);
    const VelaMediaLib::SafeRational second = frame * 30;
    std::cout << "installed VelaMediaLib: 30 NTSC frames last " << second << " s\n";
    return second == VelaMediaLib::SafeRational(1001, 1000) ? 0 : 1;
}
