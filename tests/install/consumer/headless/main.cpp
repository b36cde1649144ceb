#include <iostream>

#include "controls/Classes.h"
#include "controls/link/Link.h"
#include "hosts/headless/HeadlessHost.h"

int main() {
    tessel::headless::HeadlessHost host;
    auto& link = host.Create<tessel::controls::Link>("Link1");
    link.SetLinkTo("manual.txt");
    link.Label1.MouseDownInput(1, 0, 300, 100);
    for (const auto& entry : host.log.Of("execute")) std::cout << entry[1].ToText() << ' ' << entry[2].ToText() << '\n';
    std::cout << tessel::controls::FindControlClass("link")->table->name << '\n';
}
