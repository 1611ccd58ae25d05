@echo off
rem Takes back what register.cmd did, with the same word: unregister.cmd, or unregister.cmd user.
call "%~dp0register.cmd" undo %1
