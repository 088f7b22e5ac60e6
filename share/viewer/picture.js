// Draws a frame into the window: whole, or nearer and moved.

const NEAREST = 8; // times

class Picture {
    constructor(canvas, recording) {
        this.canvas = canvas;
        this.pen = canvas.getContext('2d');
        this.aspect = recording.width / recording.height;
        // A model stands before an even background; a walk's pictures end where they end.
        this.sides = recording.kind === 'walk' ? null : new Sides(canvas);
        this.fit();
        this.resize();
    }

    // The canvas has a point for each of the screen's, at most two a length.
    resize() {
        const box = this.canvas.getBoundingClientRect();
        this.ratio = Math.min(devicePixelRatio || 1, 2);
        this.left = box.left;
        this.top = box.top;
        this.width = Math.max(box.width, 1);
        this.height = Math.max(box.height, 1);
        this.canvas.width = Math.round(this.width * this.ratio);
        this.canvas.height = Math.round(this.height * this.ratio);
        this.wholeWidth = Math.min(this.width, this.height * this.aspect);
        this.wholeHeight = this.wholeWidth / this.aspect;
        this.keepInside();
    }

    fit() {
        this.scale = 1;
        this.x = 0; // of the picture's middle, from that of the window
        this.y = 0;
    }

    get isZoomed() { return this.scale > 1; }

    // Screen points that the whole picture needs at this scale.
    get points() { return this.wholeWidth * this.ratio * this.scale; }

    // Makes it larger by a factor; what lies under a place of the window stays there.
    zoomBy(factor, clientX, clientY) {
        const scale = Math.min(Math.max(this.scale * factor, 1), NEAREST);
        const x = clientX - this.left - this.width / 2;
        const y = clientY - this.top - this.height / 2;
        this.x = x - (x - this.x) * scale / this.scale;
        this.y = y - (y - this.y) * scale / this.scale;
        this.scale = scale;
        this.keepInside();
    }

    zoomAtMiddle(factor) {
        this.zoomBy(factor, this.left + this.width / 2, this.top + this.height / 2);
    }

    moveBy(x, y) {
        this.x += x;
        this.y += y;
        this.keepInside();
    }

    keepInside() {
        const mostX = Math.max(0, (this.wholeWidth * this.scale - this.width) / 2);
        const mostY = Math.max(0, (this.wholeHeight * this.scale - this.height) / 2);
        this.x = Math.min(Math.max(this.x, -mostX), mostX);
        this.y = Math.min(Math.max(this.y, -mostY), mostY);
    }

    // finely: worth while for a picture that rests
    draw(bitmap, finely) {
        const { pen, canvas, ratio } = this;
        const scale = ratio * this.scale * Math.min(this.wholeWidth / bitmap.width, this.wholeHeight / bitmap.height);
        const [width, height] = [bitmap.width * scale, bitmap.height * scale];
        const left = (canvas.width - width) / 2 + this.x * ratio;
        const top = (canvas.height - height) / 2 + this.y * ratio;
        pen.clearRect(0, 0, canvas.width, canvas.height);
        this.sides?.draw(bitmap, left, top, ratio);
        pen.imageSmoothingQuality = finely ? 'high' : 'low';
        pen.drawImage(bitmap, left, top, width, height);
    }
}
