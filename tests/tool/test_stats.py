"""orn-hdl stats: the counts of a design, as text and as JSON."""

from __future__ import annotations

import json
import unittest

from support import EXAMPLES, FAILED, FILE, INVERTER, SUCCESS, USAGE, ToolTest


class Stats(ToolTest):
    def counts(self, commands: str, *options: str) -> dict:
        self.write("d.cmd", commands)
        outcome = self.run_tool("stats", "d.cmd", "--format", "json", *options)
        self.assertEqual((outcome.status, outcome.err), (SUCCESS, ""))
        return json.loads(outcome.out)

    def nets(self, commands: str) -> dict:
        return self.counts(commands)["nets"]

    def test_components_by_use(self) -> None:
        counts = self.counts(INVERTER + "ADD COMPONENT SPARE\nADD COMPONENT BUF\n"
                             "ADD PIN BUF I input\nADD INSTANCE BUF U2\nADD INSTANCE BUF U3\n")
        self.assertEqual(counts["components"], [{"name": "BUF", "instances": 2},
                                                {"name": "INV", "instances": 1},
                                                {"name": "SPARE", "instances": 0}])
        self.assertEqual(counts["instances"], {"count": 3, "without_component": 0, "pins": 4,
                                               "open_pins": 2})

    def test_design_is_named_as_in_run(self) -> None:
        self.assertEqual(self.counts("")["design"], "d")
        self.assertEqual(self.counts("", "--model", "m")["design"], "m")
        self.assertEqual(self.counts("SET NETLIST NAME n\n", "--model", "m")["design"], "n")

    def test_ports_by_direction(self) -> None:
        ports = self.counts("ADD PORT A input\nADD PORT B(7:0) input\nADD PORT C(0:3) output\n"
                            "ADD PORT D bidir\nADD SIGNAL E\n")["ports"]
        self.assertEqual(ports, [{"direction": "Input", "ports": 2, "bits": 9},
                                 {"direction": "Output", "ports": 1, "bits": 4},
                                 {"direction": "BiDirectional", "ports": 1, "bits": 1}])

    def test_signals_by_width(self) -> None:
        signals = self.counts("ADD SIGNAL A\nADD SIGNAL B\nADD SIGNAL D(7:0)\nADD SIGNAL E(3:3)\n"
                              "CONNECT SIGNAL D(3:0) X(3:0)\nCONNECT SIGNAL A,B D(1:0)\n"
                              "ASSIGN CONSTANT E(3:3) 1\n")["signals"]
        self.assertEqual(signals["by_width"], [{"width": 1, "signals": 3}, {"width": 4, "signals": 1},
                                               {"width": 8, "signals": 1}])
        # Slices, bits and compounds are parts of signals.
        self.assertEqual((signals["count"], signals["bits"]), (5, 15))
        self.assertEqual((signals["aliases"], signals["constants"]), (2, 1))

    def test_nets_by_fan_out(self) -> None:
        nets = self.nets(INVERTER + "ADD INSTANCE INV U2\nADD INSTANCE INV U3\n"
                         "CONNECT SIGNAL A U2.I\nCONNECT SIGNAL A U3.I\nCONNECT SIGNAL n U2.O\n")
        self.assertEqual(nets["by_fan_out"], [{"fan_out": 0, "nets": 1}, {"fan_out": 1, "nets": 1},
                                              {"fan_out": 3, "nets": 1}])
        self.assertEqual(nets["greatest_fan_outs"], [{"name": "A", "fan_out": 3}])
        self.assertEqual(nets["unloaded"], {"count": 1, "first": ["n"]})

    def test_what_drives_and_what_reads(self) -> None:
        nets = self.nets("ADD SIGNAL alone\nADD PORT read output\nADD PORT driven input\n"
                         "ADD PORT both bidir\nADD SIGNAL constant\nASSIGN CONSTANT constant 1\n"
                         "ADD PORT Y output\nCONNECT SIGNAL Y source\n")
        self.assertEqual(nets["unconnected"], {"count": 1, "first": ["alone"]})
        self.assertEqual(nets["undriven"], {"count": 2, "first": ["read", "source"]})
        self.assertEqual(nets["unloaded"], {"count": 2, "first": ["driven", "constant"]})
        self.assertEqual(nets["multiply_driven"]["count"], 0)

    def test_bits_of_buses_are_nets(self) -> None:
        nets = self.nets("ADD PORT D(3:0) input\nADD SIGNAL U(0:3)\nCONNECT SIGNAL U(1:2) D(3:2)\n"
                         "CONNECT SIGNAL Z,W D(0),D(9)\n")
        self.assertEqual(nets["count"], 10)
        self.assertEqual(nets["unloaded"]["first"], ["D(1)", "U(1)", "U(2)", "Z", "W"])
        self.assertEqual(nets["unconnected"]["first"], ["U(0)", "U(3)"])

    def test_constant_of_a_pin_is_a_driver(self) -> None:
        nets = self.nets("ADD COMPONENT INV\nADD PIN INV I input\nADD INSTANCE INV U1\n"
                         "ASSIGN CONSTANT U1.I 1\n")
        self.assertEqual(nets["by_fan_out"], [{"fan_out": 1, "nets": 1}])
        self.assertEqual(nets["undriven"]["count"], 0)

    def test_two_drivers(self) -> None:
        nets = self.nets(INVERTER + "ADD INSTANCE INV U2\nCONNECT SIGNAL Y U2.O\n")
        self.assertEqual(nets["multiply_driven"], {"count": 1, "first": ["Y"]})

    def test_ten_names_at_most(self) -> None:
        nets = self.nets("ADD SIGNAL A(11:0)\n")
        self.assertEqual(nets["unconnected"]["count"], 12)
        self.assertEqual(nets["unconnected"]["first"], [f"A({i})" for i in range(11, 1, -1)])
        self.assertIn("unconnected                           12  A(11) A(10) A(9) A(8) A(7) A(6)"
                      " A(5) A(4) A(3) A(2) ...\n", self.run_tool("stats", "d.cmd").out)

    def test_widest_buses(self) -> None:
        counts = self.counts("ADD SIGNAL A(2147483647:0)\nCONNECT SIGNAL A(2147483647:0) B(1048575:0)\n"
                             "CONNECT SIGNAL A(5) C\n")
        self.assertEqual(counts["nets"]["count"], 1 + 1048576 + 1)
        self.assertEqual(counts["signals"]["by_width"][-1], {"width": 2147483647, "signals": 1})

    def test_attributes_by_holder(self) -> None:
        counts = self.counts(INVERTER + "ADD MODULE ATTRIBUTE a 1\nADD INSTANCE ATTRIBUTE U1 b 1\n"
                             "ADD INSTANCE ATTRIBUTE U1 c 1\nADD COMPONENT PIN ATTRIBUTE INV.I d 1\n")
        self.assertEqual(counts["attributes"],
                         [{"of": "module", "attributes": 1, "holders": 1},
                          {"of": "component", "attributes": 0, "holders": 0},
                          {"of": "instance", "attributes": 2, "holders": 1},
                          {"of": "signal", "attributes": 0, "holders": 0},
                          {"of": "pin", "attributes": 1, "holders": 1}])

    def test_cost(self) -> None:
        cost = self.counts(INVERTER)["cost"]
        self.assertEqual(cost["lines"], 8)
        self.assertGreater(cost["peak_bytes"], 1_000_000)

    def test_text(self) -> None:
        outcome = self.run_tool("stats", EXAMPLES / "counter8" / "counter8.cmd")
        self.assertEqual((outcome.status, outcome.err), (SUCCESS, ""))
        self.assertTrue(outcome.out.startswith("Design counter8\n\nInstances by component\n"))
        for line in ("DFFC                                   8", "all                                   24",
                     "Input                                  3  3 bits",
                     "Output                                 2  9 bits",
                     "3-4                                    8", "CLK                                    8",
                     "undriven                               0", "lines                                148"):
            self.assertIn(f"\n  {line}\n", outcome.out)

    def test_standard_input(self) -> None:
        outcome = self.run_tool("stats", "-", stdin=INVERTER)
        self.assertEqual(outcome.status, SUCCESS)
        self.assertTrue(outcome.out.startswith("Design HDL_NETLIST\n"))

    def test_nothing_is_written(self) -> None:
        counts = self.counts(INVERTER + "WRITE VERILOG out.v\nWRITE VHDL -APPEND out.vhd\n")
        self.assertEqual(counts["cost"]["lines"], 10)
        self.assertEqual([path.name for path in self.folder.iterdir()], ["d.cmd"])

    def test_failures(self) -> None:
        self.write("d.cmd", "ADD COMPONENT A\nADD COMPONENT A\n")
        self.expect(self.run_tool("stats", "d.cmd"), FAILED,
                    'd.cmd:2: error: Identifier "A" already defined.\n'
                    "    2 | ADD COMPONENT A\n"
                    "      |               ^\n"
                    "d.cmd:1: note: A is a component, added here\n"
                    "    1 | ADD COMPONENT A\n"
                    "      |               ^\n")
        outcome = self.run_tool("stats", "missing.cmd")
        self.assertEqual((outcome.status, outcome.out), (FILE, ""))
        self.assertEqual(self.run_tool("stats", "d.cmd", "--format", "xml").status, USAGE)


if __name__ == "__main__":
    unittest.main()
