#include "testing/real/RealProgram.h"

namespace plume::real {

namespace {

RealProgram tk() {
    constexpr const char* Script = R"(
text .text
pack .text -fill both -expand 1
bind .text <Control-a> {.text tag add sel 1.0 end-1c; break}
bind .text <<Modified>> {
    if {[.text edit modified]} {
        set file [open "{}/text" w]
        fconfigure $file -encoding utf-8
        puts $file [.text get 1.0 end-1c]
        close $file
        .text edit modified 0
    }
}
focus .text
)";
    return {"Tk text",
            "tk",
            "writing",
            {"wish", "{}/text.tcl", "-name", "writing"},
            {{.reading = Reading::File, .offers = {Needs::Lines}}},
            {{"text.tcl", Script}}};
}

RealProgram swing() {
    constexpr const char* Source = R"(
import javax.swing.*;
public class Area {
    public static void main(String[] arguments) {
        SwingUtilities.invokeLater(() -> {
            JFrame frame = new JFrame("Area");
            JTextArea area = new JTextArea(20, 80);
            area.setLineWrap(true);
            frame.add(new JScrollPane(area));
            frame.pack();
            frame.setDefaultCloseOperation(JFrame.EXIT_ON_CLOSE);
            frame.setVisible(true);
            area.requestFocusInWindow();
        });
    }
}
)";
    return {"Swing",
            "openjdk-17-jre",
            "Main",
            {"java", "{}/Area.java"},
            {{.offers = {Needs::Lines}}},
            {{"Area.java", Source}}};
}

}  // namespace

std::vector<RealProgram> others() {
    return {tk(), swing()};
}

}  // namespace plume::real
