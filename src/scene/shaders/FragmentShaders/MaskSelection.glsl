// The id of a square of a mask.
uniform vec3 u_SelectionId;

void main()
{
	gl_FragColor = vec4(u_SelectionId, 1.0 / 255.0);
}
