#pragma once

namespace quarn::program {

inline constexpr const char* SHORT_HELP = R"(usage: quarn COMMAND ...

  quarn share MODEL                            make a page and a film of a model, to send away
  quarn turntable MODEL                        record a turntable as pictures and a page
  quarn flythrough MODEL --path NAME           record a walk along a curve, looking ahead
  quarn path MODEL --camera NAME --target NAME
                                               record a camera that follows one curve and looks
                                               along another, or at a point
  quarn day MODEL --place NAME
                                               record the sun and the shadows through one day
  quarn season MODEL --place NAME
                                               record those of one time of day through the seasons
  quarn record DOC --out DIR                   record a saved animation, or a part of it with
                                               --frames RANGES; goes on where it was stopped
  quarn finish DIR                             make what such a recording lacks, then its page
  quarn farm submit DOC --out DIR              have a cluster record it
  quarn farm status DIR                        tell how far it is
  quarn farm cancel DIR                        end it; its frames stay
  quarn video FOLDER FILE                      make a film of recorded pictures: .mp4, .webm, .gif,
                                               .webp or .apng
  quarn sun --place NAME                       tell where the sun stands, and when it rises and sets
  quarn sunpath --place NAME --out FILE.svg
                                               draw the ways of the sun through a year
  quarn sunhours MODEL --place NAME --out DIR
                                               tell how many hours of sun each place gets
  quarn places [TEXT]                          list the cities that a sun study knows by name
  quarn curves MODEL                           list what a camera can follow
  quarn frame DOC --number K --out FILE        write one frame of a saved animation
  quarn camera DOC --out FILE.glb              write its camera for other programs
  quarn page FOLDER                            write a page that shows recorded frames to others
  quarn run SCRIPT [MODEL]                     run a script of host commands
  quarn console [MODEL]                        type host commands
  quarn info MODEL                             tell what a model file holds

A MODEL may be a .quarn document too. quarn --help and quarn COMMAND --help tell more.
)";

inline constexpr const char* PROGRAM_FOOTER = R"(
Examples:
  quarn share house.glb
  quarn turntable house.glb --frames 120 --out out/house --save house.quarn
  quarn flythrough house.glb --camera-curve walk.txt --even-speed --frames 240 --out out/walk
  quarn day house.glb --place Athens --date 2026-06-21 --every 10 --out out/sun
  quarn record house.quarn --out out/all
  quarn frame house.quarn --number 60 --out middle.png
  quarn camera house.quarn --out camera.glb
  quarn info house.glb
  quarn run steps.txt house.glb
  quarn console house.glb

Exit codes: 0 done, 1 failed, 2 arguments that make no sense, 130 stopped with Ctrl-C (143 by
a request to terminate). Ctrl-C lets the picture that is being recorded be finished and writes the
page; a second Ctrl-C ends the program at once.)";

inline constexpr const char* SHARE_FOOTER = R"(
A turntable is recorded as quarn turntable does it. NAME-viewer.html beside the pictures has them all
inside and turns under mouse and finger: send it alone. NAME.mp4 is the same as a film; --video names
another file, such as one that ends in .gif.

Examples:
  quarn share house.glb
  quarn share house.glb --frames 120 --out out/house --size 1920x1080)";

inline constexpr const char* TURNTABLE_FOOTER = R"(
The model is framed so that it fills the pictures well during the whole turn. The pictures are
named NAME000, NAME001, ... and NAME.html plays them in a browser. NAME.recording beside them says
which files are the recording's: others are not replaced without --overwrite. Without --out they
stand in a folder beside the model that has its name; one that holds files of yours is left alone.
The same command given again keeps the pictures that are there and whole, and makes the others.

Examples:
  quarn turntable house.glb
  quarn turntable house.glb --frames 120 --out out/house
  quarn turntable part.stl --frames 36 --out out --mode Shaded --format png --size 640x480
  quarn turntable house.glb --frames 120 --out out/film --video house.mp4
  quarn turntable part.stl --light studio --background transparent --format png --out out/cut
  quarn turntable town.obj --frames 240 --out out --elevation 35 --distance 0.8 --name Town
  quarn turntable town.obj --start-angle -30 --lens 85 --quality 95 --out out/near
  quarn turntable town.obj --frames 240 --out out --show-script > town.txt)";

inline constexpr const char* FLYTHROUGH_FOOTER = R"(
The camera runs along the curve from its start and looks in every picture at the place where the
next one is taken; the horizon stays level. The curve itself is not in the pictures.

A curve file holds a point a line, as X Y Z or X,Y,Z, in the model's units with Z up; a camera at
eye height stands 1.6 above the floor of a model in metres. A line "degree 3" before the first
point makes a smooth curve of them, which passes near the points; a line "closed" a round tour.

Examples:
  quarn curves town.quarn
  quarn flythrough town.quarn --path "Main street" --even-speed --frames 300 --out out/street
  quarn flythrough house.glb --camera-curve walk.txt --even-speed --frames 240 --out out/walk
  quarn flythrough house.glb --camera-curve walk.txt --frames 240 --out out --save walk.quarn)";

inline constexpr const char* PATH_FOOTER = R"(
Camera and target run through their curves in the same number of pictures; either may be a point,
where it stays. The curves are not in the pictures; the horizon stays level. quarn flythrough
--help tells what a curve file holds.

Examples:
  quarn path town.quarn --camera "Roof line" --target Fountain --frames 240 --out out/roofs
  quarn path part.stl --camera-curve arc.txt --target-point 0,0,12 --frames 120 --out out/part
  quarn path hall.glb --camera-point 2,-4,1.6 --target-curve frieze.json --frames 90 --out out)";

inline constexpr const char* DAY_FOOTER = R"(
A picture is taken at --from, and every so many minutes later until --to; both may be in the night.
sunrise and sunset are those of published tables: the sun's upper edge at the horizon, with the air
that lifts it.

Examples:
  quarn day house.glb --place Athens --out out/today
  quarn day house.glb --place Berlin --date solstice-june --from sunrise+1h --to sunset-30m --out sun
  quarn day house.obj --latitude 51.5 --longitude -0.12 --north 12 --date 2026-12-21 --out out/dec
  quarn day site.quarn --place "Mexico City" --date 2026-03-20 --view Top --out out/plan
)";

inline constexpr const char* SEASON_FOOTER = R"(
A picture is taken on the date of --from, and every so many days later until that of --to. Without
dates it is this year, with one of them the year that begins or ends with it. All pictures keep the
same time of the place's standard clock: where clocks are put forward in summer they show an hour
more, and so do the captions.

Examples:
  quarn season house.glb --place Athens --out out/year
  quarn season house.glb --place Athens --from 2026-01-01 --to 2026-12-31 --at 11:00 --out out/year
  quarn season yard.obj --place Sydney --from 2026-06-21 --to 2026-12-21 --every 1 --out out/spring
)";

/// Follows the footers of the two sun studies.
inline constexpr const char* SITE_FOOTER = R"(
North: the sun stands as if the model's Y axis pointed north. --north 30 says that north lies 30
degrees clockwise from the Y axis, as seen from above.

Clock: times are those of clocks on the wall there, with daylight saving as it was, is or will be on
that day. A place by latitude and longitude has the clocks of the nearest city known; --zone takes
others. An hour that is skipped when clocks are put forward is refused; of one that comes twice --from
takes the first and --to the second. The zone and the universal time of the first picture are told
before the recording begins. Seconds are always 0.

The recording's own page tells times by the whole hours of the longitude, without daylight saving.
Those of a season count eastward, so that 105.18 W is UTC+16 there, the hour of UTC-8 with the next
day's date. The list of frames, films and the page of --viewer tell those of the clocks on the wall.)";

inline constexpr const char* SUN_HOURS_FOOTER = R"(
Written into the folder, NAME being the model file's:
  NAME-sunhours.png    the picture in colours, with title and legend, to print
  NAME-sunhours.html   a page to read: the pointer tells the hours, a slider goes through the day
  NAME-sunhours.npy    the hours of each pixel as 32-bit floats, for NumPy and others
  NAME-sunhours.csv    of each object its area, the mean of its hours, and the share of its area
                       that gets at least --threshold hours; and the same of what looks up
  NAME-sunhours.ply    with --grid: all surfaces in small triangles, with colours and hours

An hour counts where the side of a surface that is seen looks toward the sun, the sun's centre stands
above the horizon, and nothing is between. Glass, less than half opaque or letting more than half of
the light through, shades nothing and is looked through; everything else shades. Times are those of
the clocks of the place, with daylight saving. Of several days the hours are the mean of a day; ends
such as sunrise+1h are each day's own then, and midnight on days without a sunrise or sunset. An hour
that is skipped when clocks are put forward is refused on the first day; later ones begin with the
change. Files that are there already are replaced with --overwrite alone.

Examples:
  quarn sunhours house.glb --place Athens --date 2026-03-21 --view plan --out out/hours
  quarn sunhours house.glb --place Athens --date solstice-june --from sunrise+1h --to 17:00 --isolines 1 --out out/day
  quarn sunhours house.glb --place Athens --date 2026-01-01 --to-date 2026-12-31 --every-days 30 --every 30 --out out/year)";

inline constexpr const char* RECORD_FOOTER = R"(
The same command goes on where it was stopped or killed: frames that are whole stay, all others are
made. Where the document has changed since, or a setting of its pictures, it says so and writes
nothing. Several programs, on one machine or many that see the same folder, may record the same
document into it at the same time: no frame is made twice.

Ranges count frames from 0 as file names do, with both ends: 0-9 are ten frames, 20-30:2 is every
other one, 12-12 is one. Without --frames the page and the list of frames are written at the end.

Examples:
  quarn record house.quarn --out out/house
  quarn record house.quarn --out out/parts --frames 0-99
  quarn record house.quarn --out out/parts --frames 100-199
  quarn finish out/parts --viewer
  quarn record house.quarn --out out/jobs --jobs 2)";

inline constexpr const char* FINISH_FOOTER = R"(
Every frame is looked at: those that are missing, cut or changed are made again, and then the page,
the list of frames and what is asked for besides. A recording that is whole already is only looked at.
The folder knows its document; --document is for one that was moved.

Examples:
  quarn record house.quarn --out out/house --frames 0-49
  quarn finish out/house --video house.mp4
  quarn finish out/house --document house.quarn --viewer)";

inline constexpr const char* FARM_FOOTER = R"(
The cluster runs Slurm, and all its nodes see the document and the folder under the same paths.
docs/farm.md tells more, and how other schedulers do it. quarn farm submit --help tells the options.

Examples:
  quarn farm submit house.quarn --out out/farm
  quarn farm status out/farm
  quarn farm cancel out/farm)";

inline constexpr const char* SUBMIT_FOOTER = R"(
One frame is drawn here to see what it takes, and the frames that are missing are shared out to the
tasks of a job array; a last job makes what is missing then, and the page. NAME.farm.sh beside the
frames is the script that all of them run. Submitted again after something went wrong, only the
frames that are missing are recorded.

A task is asked to stop one frame's time before its time is up: it then ends between two frames, and
goes back into the queue. Other options of sbatch are taken from the environment, as sbatch does it:
SBATCH_ACCOUNT, SBATCH_QOS, SBATCH_MEM_PER_NODE.

Examples:
  quarn farm submit house.quarn --out out/farm --frame-time 20 --dry-run
  quarn farm submit house.quarn --out out/farm --tasks 40 --cpus 4 --video house.mp4 --dry-run)";

inline constexpr const char* STATUS_FOOTER = R"(
Told by what the folder holds, by Slurm, and by the logs of the tasks in NAME.farm. The exit code is
0 while something goes on and once all is done, and 1 where frames are missing and nothing goes on.)";

inline constexpr const char* CANCEL_FOOTER = R"(
The frames that are there stay, and quarn farm submit goes on with the others.)";

inline constexpr const char* VIDEO_FOOTER = R"(
The pictures stand in the film in the order of their numbers. An mp4 plays everywhere; a webm is
smaller, and takes several times as long; a gif has 256 colours, chosen from all pictures; an apng
loses nothing and is large. With --video FILE a recording makes the film while it draws.

Examples:
  quarn turntable house.glb --frames 120 --out out/house
  quarn video out/house house.mp4
  quarn video out/house house.gif --width 480 --fps 20
  quarn day house.glb --place Athens --date 2026-06-21 --out out/sun --video sun.mp4 --caption)";

inline constexpr const char* SUN_FOOTER = R"(
Times are those of the clock on the wall, daylight saving included. Azimuths are degrees clockwise
from north; altitudes are those of the sun's centre above a level horizon, without refraction. The
sun rises and sets where published tables have it: with its centre 50 minutes of arc below the
horizon (34 of refraction, 16 of half diameter). Without --time and --date it is now. --date alone
tells a whole day, every hour; the years are 1800 to 2199. Of a time that comes twice --time takes the
first and --to the second.

Examples:
  quarn sun --place Berlin
  quarn sun --place Berlin --date solstice-june
  quarn sun --place Berlin --time "2026-03-21 09:00" --to "2026-03-21 17:00" --every 30
  quarn sun --latitude 69.65 --longitude 18.96 --date 2026-12-21 --format json
  quarn sun --place Athens --date 2026-06-21 --every 10 --format csv > sun.csv)";

inline constexpr const char* SUNPATH_FOOTER = R"(
The sky is a disk with the zenith in its middle and north up. Lines show the sun's way on the 21st of
each month, loops where it stands at each whole hour of the place's standard time (in summer time
clocks show an hour more). FILE ends in .svg, which every drawing program opens, or in .png.

With a MODEL and --point or --object what hides the sky from there is grey: where a line is on grey,
the point is in shade. A point on a surface should be a little off it; an object is looked at from
the middle of its box, and hides nothing itself. Glass hides nothing. --north 30 says that north lies
30 degrees clockwise from the model's Y axis.

Examples:
  quarn sunpath --place Berlin --out berlin.svg
  quarn sunpath --place Sydney --year 2030 --projection both --out sydney.png
  quarn sunpath house.obj --place Athens --north 20 --point 2,-1,1.5 --out terrace.svg)";

inline constexpr const char* PLACES_FOOTER = R"(
The last column tells whose clocks the times of a study are of, with daylight saving as it was, is or
will be in that place.

Examples:
  quarn places
  quarn places spain)";

inline constexpr const char* CURVES_FOOTER = R"(
A line tells the name (the id, where there is none), the kind, the length in the model's units,
whether it is closed, and the number of points that define it.

Example:
  quarn curves town.obj)";

inline constexpr const char* FRAME_FOOTER = R"(
The frame is drawn as the recording draws it; at the view's own size it is the same file, but for two
cases: where the camera stands straight above or below its target, and in a view with a tilted
horizon. A recording levels the horizon; a single frame keeps it tilted, and fails where the view
takes no direction for it as pointing up.

Examples:
  quarn frame house.quarn --number 0 --out first.jpg
  quarn frame house.quarn --number 60 --size 3840x2160 --out middle.png
  quarn frame house.quarn --number 60 --light sky --exposure 0.5 --out brighter.png)";

inline constexpr const char* CAMERA_FOOTER = R"(
Each frame of the recording has one key: the camera that it is drawn with. glTF is in metres with Y
up, and of a sun study it holds the camera that stands still and the sun as a light that turns; JSON
and CSV are in the model's units with Z up, and hold every digit.

Examples:
  quarn camera house.quarn --out camera.glb
  quarn camera house.quarn --out camera.csv --fps 25)";

inline constexpr const char* PAGE_FOOTER = R"(
NAME-viewer.html is written beside the frames: a turntable turns under mouse and finger, a walk has a
slider, a sun study shows date, time and the sun. It plays in every browser, from disk or from a web
server, and calls nobody. With --one-file the pictures are in it, and it needs no folder. A file of
this name that is no such page is replaced only with --overwrite.

Examples:
  quarn page frames
  quarn page frames --one-file --title "The house by the lake")";

inline constexpr const char* RUN_FOOTER = R"(
A script holds one host command a line; the words after a command's name answer its questions.
Blank lines and lines that start with # are skipped. The first command that fails ends the run. A
recording that lacks pictures at its end is a failure too, told when the script has ended.

Example (steps.txt):
  # a turntable of the model that is read first; the folder out must be there
  _-StandardView _Perspective
  _-FitView _Turn=Yes _Enter
  _-SetTurntableAnimation 36 _Clockwise _png _Shaded _Enter _Enter
  _-RecordAnimation _TargetFolder "out" _Enter

  quarn run steps.txt house.glb

The command Help lists every command; quarn turntable ... --show-script prints a whole script.)";

inline constexpr const char* CONSOLE_FOOTER = R"(
A command asks for what it needs: "Number of frames <100>: ". What stands in < > is the answer of
an empty line; what stands in ( ) are options, picked by typing their names (in a question for
text as they stand there, with their brackets). Answers may also follow the command's name on its
line; the command asks for those that are missing, and again for one that does not fit.

  Tab        completes names of commands, options, objects and files
  Up, Down   call back earlier lines; those of earlier runs are kept in
             $XDG_STATE_HOME/quarn/history or else ~/.local/state/quarn/history
  Ctrl-C     cancels the command that asks; ends a recording after the current picture (a second
             one, while a command is at work, ends the program at once)
  Ctrl-D     ends the program where a command is asked for, as Exit does; nothing is saved then

What is not saved is kept for recovery as work goes on (--recovery-every). When the program ends
otherwise than by Exit or Ctrl-D, its next start says so, and the command Recover opens or discards
what was kept.

An empty line where a command is asked for does nothing; Up and Enter repeat the last command. What
is piped in is read as if it were typed; there lines that start with # are skipped.

Example:
  quarn console house.glb
  Command: SetTurntableAnimation 36 Clockwise
  File type <jpg> ( jpg bmp png tga ):)";

inline constexpr const char* INFO_FOOTER = R"(
Example:
  quarn info house.glb)";

} // namespace quarn::program
