# The Tcl package, loaded from the folder that the first argument names.

lappend auto_path [lindex $argv 0]
set argv [lrange $argv 1 end]
package require tcltest
package require orn_hdl
namespace import ::tcltest::test ::tcltest::makeFile ::tcltest::removeFile ::tcltest::viewFile
::tcltest::configure {*}$argv
::tcltest::configure -tmpdir [file normalize [exec mktemp -d]]

set lines {ADD COMPONENT INV
ADD PIN INV I input
ADD PIN INV O output
ADD PORT A input
ADD PORT Y output
ADD INSTANCE INV U1
CONNECT SIGNAL A U1.I
CONNECT SIGNAL Y U1.O
ADD SIGNAL ATTRIBUTE Y LOC P4}

# A model with these lines.
proc small {} {
    set model [orn_hdl::create top]
    foreach line [split $::lines \n] {
        $model execute $line
    }
    return $model
}

# The result and the error code of a script that fails.
proc failure {script} {
    if {![catch {uplevel 1 $script} message options]} {
        error "no failure"
    }
    return [list $message [dict get $options -errorcode]]
}

test version {the package has the library's version} {
    expr {[package provide orn_hdl] eq [orn_hdl::version]}
} 1

test no-model {a line needs a model} {
    failure {orn_hdl::execute NOOP}
} {{there is no current model} {ORN_HDL NULL_HANDLE}}

test lists {what a design holds} -setup {set m [small]} -body {
    list [$m name] [$m components] [$m instances] [$m signals] [$m connections] \
        [$m attributes signal Y] [lmap finding [$m check] {lrange $finding 0 1}]
} -cleanup {$m destroy} -result {top INV U1 {A Y} {{U1 I input A} {U1 O output Y}} {LOC P4} {{warning missing-configuration}}}

test current {lines go to the model that was made last, or is used} -body {
    set first [orn_hdl::create first]
    set second [orn_hdl::create second]
    orn_hdl::execute "ADD PORT S input"
    $first use
    orn_hdl::execute "ADD PORT F input"
    list [$first signals] [$second signals]
} -cleanup {$first destroy; $second destroy} -result {F S}

test failed-line {a line that fails} -setup {set m [small]} -body {
    list [failure {$m execute "ADD INSTANCE MISSING U2"}] \
        [failure {orn_hdl::execute NONSENSE}]
} -cleanup {$m destroy} -result {{{Component "MISSING" not found.} {ORN_HDL FAILED}} {{Command not find.} {ORN_HDL FAILED}}}

test failures {other failures} -setup {set m [small]} -body {
    list [failure {$m attributes signal NONE}] [failure {orn_hdl::create top}] \
        [lindex [failure {$m write verilog /nowhere/a.v}] 1] \
        [lindex [failure {orn_hdl::run /nowhere/a.cmd}] 1]
} -cleanup {$m destroy} -result {{{not found} {ORN_HDL NOT_FOUND}} {{name taken} {ORN_HDL EXISTS}} {ORN_HDL FILE} {ORN_HDL FILE}}

test run {a file is replayed, and its netlists are written} -setup {
    set file [makeFile $lines mixer.cmd]
} -body {
    set m [orn_hdl::run $file]
    $m option header off
    set out [file rootname $file].v
    $m write verilog $out
    set channel [open $out]
    set written [read $channel]
    close $channel
    list [$m name] [$m option header] [string match "*module mixer*INV U1*endmodule*" $written]
} -cleanup {
    $m destroy
    file delete $out
    removeFile mixer.cmd
} -result {mixer 0 1}

test run-failure {the place of a failure} -setup {
    set file [makeFile "NOOP\nADD PIN\n" bad.cmd]
} -body {
    set failed [failure {orn_hdl::run $file}]
    # The model of a file that fails is gone.
    set again [failure {orn_hdl::run $file}]
    list [expr {[lindex $failed 0] eq "$file:2: ADD PIN: Invalid Arguments."}] \
        [expr {[lindex $failed 1] eq [list ORN_HDL FAILED $file 2]}] \
        [expr {$failed eq $again}]
} -cleanup {removeFile bad.cmd} -result {1 1 1}

proc progress {lines bytes} {
    lappend ::progress $lines
}
proc deleter {lines bytes} {
    if {[info commands $::m] ne ""} {
        $::m destroy
    }
}

test progress {a script is told of the progress, and may stop or delete} -setup {
    set file [makeFile [string repeat "NOOP\n" 9000] long.cmd]
} -body {
    set ::progress {}
    set m [orn_hdl::run $file progress]
    set failed [failure {$m run $file {error stop}}]
    set code [lindex [failure {$m run $file {return -code break}}] 1]
    $m run $file deleter
    list $::progress [lindex $failed 0] $code [info commands $m]
} -cleanup {removeFile long.cmd} -result {{4096 8192} stop {ORN_HDL STOPPED} {}}

test texts {a design as text gives the design again} -setup {set m [small]} -body {
    $m option header off
    set commands [$m text commands]
    set copy [orn_hdl::create copy]
    foreach line [split $commands \n] {
        $copy execute $line
    }
    $copy option header off
    list [expr {[$copy text verilog] eq [$m text verilog]}] \
        [expr {[$copy text vhdl] eq [$m text vhdl]}] [expr {[$copy text commands] eq $commands}]
} -cleanup {$m destroy; $copy destroy} -result {1 1 1}

test dontcares {a digit - is a don't care when the option says so} -setup {set m [small]} -body {
    $m execute {ASSIGN CONSTANT k(1:0) 2:B:1-}
    set before [string match "*= 2'b1-;*" [$m text verilog]]
    $m option dontcares on
    list $before [$m option dontcares] [string match "*= 2'b1x;*" [$m text verilog]] \
        [string match "*<= \"1-\";*" [$m text vhdl]]
} -cleanup {$m destroy} -result {1 1 1 1}

test read {a netlist is read} -setup {
    set file [makeFile "module top(a, y);\ninput a;\noutput y;\nCELL u(.I(a), .O(y));\nendmodule" a.v]
    set cells [makeFile "module CELL(I, O);\ninput I;\noutput O;\nendmodule" cells.v]
} -body {
    set m [orn_hdl::create read]
    set failed [failure {$m read verilog $file}]
    $m read verilog $file $cells
    list [lindex $failed 1] [string match "$file:4:*error:*" [lindex $failed 0]] [$m connections]
} -cleanup {
    $m destroy
    removeFile a.v
    removeFile cells.v
} -result {{ORN_HDL FAILED} 1 {{u I input a} {u O output y}}}

test deleted {a model lives as long as its command} -body {
    set m [small]
    rename $m other
    other execute "ADD PORT B input"
    rename other ""
    set m [small]
    $m destroy
    failure {orn_hdl::execute NOOP}
} -result {{there is no current model} {ORN_HDL DEAD_HANDLE}}

test interpreters {each interpreter has an engine of its own} -body {
    set inner [interp create]
    $inner eval [list set auto_path $auto_path]
    $inner eval {package require orn_hdl; set m [orn_hdl::create top]}
    set outer [small]
    set seen [$inner eval {$m instances}]
    interp delete $inner
    list $seen [$outer instances]
} -cleanup {$outer destroy} -result {{} U1}

test words {wrong words} -setup {set m [small]} -body {
    list [catch {$m} text] $text [catch {$m nonsense}] [catch {$m write} text] $text \
        [catch {$m write basic a.v}] [catch {$m execute}] [catch {$m option header maybe}] \
        [catch {orn_hdl::create}] [catch {orn_hdl::run}] [catch {$m attributes pin x}]
} -cleanup {$m destroy} -match glob -result {1 {wrong # args: should be "* subcommand ?argument ...?"} 1 1 {wrong # args: should be "* write language file ?-append?"} 1 1 1 1 1 1}

file delete -force [::tcltest::temporaryDirectory]
set failed $::tcltest::numTests(Failed)
puts "tcl: $::tcltest::numTests(Passed) of $::tcltest::numTests(Total) tests passed"
exit [expr {$failed > 0}]
