// Which frame is shown: it plays, is dragged, and runs on when it is let go.

const GLIDE_S = 0.32;        // after this time a third of the speed is left
const SLOWEST = 1.5;         // frames a second at which it comes to rest
const FASTEST_TURNS = 3;     // a second, however hard it is thrown

class Motion {
    constructor(recording, moved) {
        this.count = recording.count;
        this.cyclic = recording.kind === 'turntable';
        this.rate = recording.rate;
        this.loops = true;
        this.moved = moved;
        this.place = 0;  // in frames, with a fraction
        this.speed = 0;  // frames a second, after it was let go
        this.isPlaying = false;
        this.lastTick = null;
    }

    get frame() {
        const frame = Math.floor(this.place + 0.5);
        return this.cyclic ? frame % this.count : frame;
    }
    get direction() { return this.isPlaying ? 1 : Math.sign(this.speed); }
    get isMoving() { return this.isPlaying || this.speed !== 0; }

    play(isPlaying) {
        if (isPlaying && !this.cyclic && this.frame === this.count - 1) this.place = 0;
        this.isPlaying = isPlaying && this.count > 1;
        this.speed = 0;
        this.run();
        this.moved();
    }

    goTo(place) {
        this.place = this.cyclic
            ? ((place % this.count) + this.count) % this.count
            : Math.min(Math.max(place, 0), this.count - 1);
        this.moved();
    }

    // A person takes it: it neither plays nor runs on.
    hold() {
        this.isPlaying = false;
        this.speed = 0;
        this.moved();
    }

    letGo(speed) {
        const fastest = FASTEST_TURNS * this.count;
        this.speed = Math.min(Math.max(speed, -fastest), fastest);
        this.run();
        this.moved();
    }

    run() {
        if (!this.isMoving || this.lastTick !== null) return;
        this.lastTick = performance.now();
        requestAnimationFrame((now) => this.tick(now));
    }

    tick(now) {
        const seconds = Math.min(Math.max(now - this.lastTick, 0) / 1000, 0.25);
        this.lastTick = null;
        if (this.isPlaying) this.playFor(seconds);
        else if (this.speed !== 0) this.glideFor(seconds);
        if (this.isMoving) {
            this.lastTick = now;
            requestAnimationFrame((next) => this.tick(next));
        }
    }

    playFor(seconds) {
        const place = this.place + seconds * this.rate;
        const isPastEnd = place > this.count - 0.5;
        if (!isPastEnd || this.cyclic && this.loops) return this.goTo(place);
        if (this.loops) return this.goTo(place - this.count);
        this.isPlaying = false;
        this.goTo(this.count - 1);
    }

    glideFor(seconds) {
        const place = this.place + this.speed * seconds;
        this.speed *= Math.exp(-seconds / GLIDE_S);
        const hitsEnd = !this.cyclic && (place <= 0 || place >= this.count - 1);
        if (Math.abs(this.speed) < SLOWEST || hitsEnd) this.speed = 0;
        this.goTo(place);
    }
}
