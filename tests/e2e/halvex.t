halvex: the version line, the release level (GA, a pre-release name, an
update), the build number's padding, and the help paths.

=== snapshot ga
{"buildDate": "Nov 30 2026",
 "tree": {"system": {"version": {"product": "Orvik", "version": "9.1.0",
                                 "releaseLevel": "Release", "update": "0", "build": 42}}}}
=== snapshot update extends ga
{"tree": {"system": {"version": {"update": "2a", "build": 1234567}}}}
=== snapshot beta extends ga
{"tree": {"system": {"version": {"releaseLevel": "Beta 2", "update": "0.1", "build": 12345}}}}
=== snapshot release-prefix extends ga
{"tree": {"system": {"version": {"releaseLevel": "Releases"}}}}
=== snapshot no-update-text extends ga
{"tree": {"system": {"version": {"update": ""}}}}
=== snapshot full-product extends ga
{"tree": {"system": {"version": {"product": "OrvikHypervisorForTheDataCenter!"}}}}
=== snapshot unreadable
{"buildDate": "Nov 30 2026",
 "tree": {"system": {"version": {"$status": "0xbad0003"}}}}
=== case -v: a build number of 42 is padded to five digits
snapshot: ga
run: halvex -v
exit: 0
--- stdout
Orvik 9.1.0 build-00042
=== case -l: Release shows as GA
snapshot: ga
run: halvex --level
exit: 0
--- stdout
Orvik 9.1.0 GA
=== case both flags: the version line first, each once
snapshot: ga
run: halvex -l -v -l --version
exit: 0
--- stdout
Orvik 9.1.0 build-00042
Orvik 9.1.0 GA
=== case an update replaces the level word; a build number of seven digits in full
snapshot: update
run: halvex -vl
exit: 0
--- stdout
Orvik 9.1.0 build-1234567
Orvik 9.1.0 Update 2a
=== case another release level is shown unchanged; an update text starting with 0 is no update
snapshot: beta
run: halvex -v -l
exit: 0
--- stdout
Orvik 9.1.0 build-12345
Orvik 9.1.0 Beta 2
=== case only the exact text Release is GA
snapshot: release-prefix
run: halvex -l
exit: 0
--- stdout
Orvik 9.1.0 Releases
=== case an empty update text does not start with 0: an update
snapshot: no-update-text
run: halvex -l
exit: 0
--- stdout
Orvik 9.1.0 Update 
=== case a product name that fills its field has no NUL
snapshot: full-product
run: halvex -v
exit: 0
--- stdout
OrvikHypervisorForTheDataCenter! 9.1.0 build-00042
=== case the version record cannot be read
snapshot: unreadable
run: halvex -v -l
exit: 1
=== case no option
snapshot: ga
run: halvex
exit: 1
--- stderr
halvex: no option specified
halvex      -v, --version         Get version information for orvik
            -l, --level           Get release level information
            -h, --help            Print this menu
=== case an operand only
snapshot: ga
run: halvex version
exit: 1
--- stderr
halvex: Invalid arguments
halvex      -v, --version         Get version information for orvik
            -l, --level           Get release level information
            -h, --help            Print this menu
=== case -h, even with -v; --help the same
snapshot: ga
run: halvex -v -h
check: test "$(@BIN/orxkeltools -c @CACHE halvex --help 2>&1; echo $?)" = "$(@BIN/orxkeltools -c @CACHE halvex -h 2>&1; echo $?)"
exit: 1
--- stderr
halvex      -v, --version         Get version information for orvik
            -l, --level           Get release level information
            -h, --help            Print this menu
=== case an unknown option
snapshot: ga
run: halvex -v -x
exit: 1
--- stderr
halvex: invalid option -- 'x'
halvex      -v, --version         Get version information for orvik
            -l, --level           Get release level information
            -h, --help            Print this menu
