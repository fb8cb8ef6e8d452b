@echo off
rem Runs everything and writes trial.txt: see README.txt.
cd /d "%~dp0"
echo Running. This window closes when trial.txt is complete.
scenario_test.exe --this-machine-is-disposable --gtest_color=no %* > trial.txt 2>&1
